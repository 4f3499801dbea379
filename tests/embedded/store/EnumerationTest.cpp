#include <algorithm>
#include <functional>

#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

// An enumeration: its size, and how to run it with a callback that returns what `goOn` returns.
struct TEnumeration {
    const char* name;
    std::size_t size;
    std::function<void(const std::function<bool()>& goOn)> run;
};

// A callback for elements of any type.
auto Ask(const std::function<bool()>& goOn)
{
    return [&goOn](const auto&) { return goOn(); };
}

// The devices with two instances of each class, and at least three of everything else that can be enumerated.
class EnumerationTest : public TDevicesFixture {
  protected:
    EnumerationTest()
    {
        DeclareMembers();
        for (const char* const name : {"Units", "Version", "Key"}) {
            fNamespace->AllocateQualifierDecl(name, TCIMValue(false), ICIMQualifierDecl::kScopeAny,
                                              ICIMQualifierDecl::kFlavorDefault, kNoContext);
        }
        fCabinet =
            Declare("Cabinet", nullptr,
                    {{"Row", TType::kUint32, {"Key"}}, {"Place", TType::kUint32, {"Key"}}, {"Side", TType::kString, {"Key"}}});
        Associate("Location", "Room");
        Associate("Cooling", "Fan");
        Associate("Mounting", "Cabinet");
        for (const TClassPointer& cls : {fDevice, fDisk, fSolidState, fFan}) {
            Add(cls, {{"Id", cls->GetName(kNoContext) + "1"}});
            Add(cls, {{"Id", cls->GetName(kNoContext) + "2"}});
        }
        fMounted = Add(fCabinet, {{"Row", TCIMValue(3U)}, {"Place", TCIMValue(4U)}, {"Side", "front"}});
    }

    void DeclareMembers()
    {
        for (const char* const name : {"Count", "Limit"}) {
            fDevice->AddPropertyDecl(Decl({name, TType::kUint32, {"Static"}}));
        }
        fDisk->AddPropertyDecl(Decl({"Spare", TType::kUint32, {"Static"}}));
        fDevice->AddMethodDecl(fDevice->AllocateMethodDecl("Start", TType::kUint32, kNoContext));
        fDevice->AddMethodDecl(fDevice->AllocateMethodDecl("Stop", TType::kUint32, kNoContext));
        fDisk->AddMethodDecl(fDisk->AllocateMethodDecl("Format", TType::kUint32, kNoContext));
        fDevice->AddQualifier(Qualifier("Version"));
        fDevice->AddQualifier(Qualifier("Units"));
        fDisk->AddQualifier(Qualifier("Revised"));
        fDisk->AddQualifier(Qualifier("Deprecated"));
    }

    void Associate(const std::string& name, const std::string& className)
    {
        const auto association = Allocate(name, nullptr);
        association->AddQualifier(Qualifier("Association"));
        association->AddPropertyDecl(Reference("Thing", "Device"));
        association->AddPropertyDecl(Reference("Other", className));
        association->AddToNamespace(kNoContext);
    }

    std::vector<TEnumeration> OfTheNamespace()
    {
        return {
            {"root classes", 6, [&](auto& goOn) { fNamespace->EnumerateRootClasses(Ask(goOn), kNoContext); }},
            {"qualifier declarations", 3, [&](auto& goOn) { fNamespace->EnumerateQualifierDecls(Ask(goOn), kNoContext); }},
            {"answers of a query", 8, [&](auto& goOn) { Query("SELECT * FROM Device", goOn); }},
            {"answers of a query with a condition", 4, [&](auto& goOn) { Query("SELECT * FROM Device WHERE Id LIKE '%2'", goOn); }},
            {"classes below the pseudo-class", 6, [&](auto& goOn) { Root()->EnumerateSubClasses(Ask(goOn), false, kNoContext); }},
            {"all classes", 9, [&](auto& goOn) { Root()->EnumerateSubClasses(Ask(goOn), true, kNoContext); }},
            {"all instances", 9, [&](auto& goOn) { Root()->EnumerateInstances(Ask(goOn), true, kNoContext); }},
        };
    }

    std::vector<TEnumeration> OfAClass()
    {
        return {
            {"subclasses", 3, [&](auto& goOn) { fDevice->EnumerateSubClasses(Ask(goOn), true, kNoContext); }},
            {"associated classes", 3,
             [&](auto& goOn) { fDevice->EnumerateAssociatedClasses(Ask(goOn), "", "", "", "", kNoContext); }},
            {"association classes", 3, [&](auto& goOn) { fDevice->EnumerateAssociationClasses(Ask(goOn), "", "", kNoContext); }},
            {"key names", 3, [&](auto& goOn) { fCabinet->EnumerateKeyNames(Ask(goOn), kNoContext); }},
            {"property declarations", 6, [&](auto& goOn) { fSolidState->EnumeratePropertyDecls(Ask(goOn), kNoContext); }},
            {"static properties", 3, [&](auto& goOn) { fSolidState->EnumerateStaticProperties(Ask(goOn), kNoContext); }},
            {"instances", 2, [&](auto& goOn) { fDevice->EnumerateInstances(Ask(goOn), false, kNoContext); }},
            {"instances of subclasses too", 8, [&](auto& goOn) { fDevice->EnumerateInstances(Ask(goOn), true, kNoContext); }},
            {"method declarations", 3, [&](auto& goOn) { fSolidState->EnumerateMethodDecls(Ask(goOn), kNoContext); }},
            {"qualifiers, inherited ones too", 4, [&](auto& goOn) { fDisk->EnumerateQualifiers(Ask(goOn), kNoContext); }},
        };
    }

    std::vector<TEnumeration> OfAnInstance()
    {
        return {
            {"properties", 3, [&](auto& goOn) { fMounted->EnumerateProperties(Ask(goOn), kNoContext); }},
            {"key bindings", 3, [&](auto& goOn) { fMounted->GetReference(kNoContext).EnumerateKeyBindings(Ask(goOn)); }},
        };
    }

    void Query(std::string query, const std::function<bool()>& goOn)
    {
        std::string language = "WQL";
        fNamespace->ExecuteQuery(Ask(goOn), language, query, kNoContext);
    }

    // Runs each enumeration several times: once ended at each of its elements, and once to its end.
    static void ExpectToEndAtEachElement(const std::vector<TEnumeration>& enumerations)
    {
        for (const TEnumeration& each : enumerations) {
            for (std::size_t last = 1; last <= each.size + 1; ++last) {
                std::size_t delivered = 0;
                each.run([&] { return ++delivered < last; });
                EXPECT_EQ(std::min(last, each.size), delivered) << each.name << ", to end at number " << last;
            }
        }
    }

    TClassPointer fCabinet;
    TInstancePointer fMounted;
};

TEST_F(EnumerationTest, OfANamespaceEndsWhenTheCallbackReturnsFalse)
{
    ExpectToEndAtEachElement(OfTheNamespace());
}

TEST_F(EnumerationTest, OfAClassEndsWhenTheCallbackReturnsFalse)
{
    ExpectToEndAtEachElement(OfAClass());
}

TEST_F(EnumerationTest, OfAnInstanceEndsWhenTheCallbackReturnsFalse)
{
    ExpectToEndAtEachElement(OfAnInstance());
}

}  // namespace
}  // namespace NORVZEL20
