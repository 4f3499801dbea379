#include <algorithm>
#include <functional>

#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

// An enumeration, how many elements it has, and how to run it with a callback that asks `goOn` for its answer.
struct TEnumeration {
    const char* name;
    std::size_t size;
    std::function<void(const std::function<bool()>& goOn)> run;
};

// For any type of element.
auto Ask(const std::function<bool()>& goOn)
{
    return [&goOn](const auto&) { return goOn(); };
}

// The devices with two instances of each class, and of everything else that can be enumerated at least three.
class EnumerationTest : public TDevicesFixture {
  protected:
    EnumerationTest()
    {
        DeclareMembers();
        for (const char* const name : {"Units", "Version", "Key"}) {
            ns->AllocateQualifierDecl(name, TCIMValue(false), ICIMQualifierDecl::kScopeAny, ICIMQualifierDecl::kFlavorDefault,
                                      none);
        }
        cabinet =
            Declare("Cabinet", nullptr,
                    {{"Row", TType::kUint32, {"Key"}}, {"Place", TType::kUint32, {"Key"}}, {"Side", TType::kString, {"Key"}}});
        Associate("Location", "Room");
        Associate("Cooling", "Fan");
        Associate("Mounting", "Cabinet");
        for (const TClassPointer& cls : {device, disk, solidState, fan}) {
            Add(cls, {{"Id", cls->GetName(none) + "1"}});
            Add(cls, {{"Id", cls->GetName(none) + "2"}});
        }
        mounted = Add(cabinet, {{"Row", TCIMValue(3U)}, {"Place", TCIMValue(4U)}, {"Side", "front"}});
    }

    void DeclareMembers()
    {
        for (const char* const name : {"Count", "Limit"}) {
            device->AddPropertyDecl(Decl({name, TType::kUint32, {"Static"}}));
        }
        disk->AddPropertyDecl(Decl({"Spare", TType::kUint32, {"Static"}}));
        device->AddMethodDecl(device->AllocateMethodDecl("Start", TType::kUint32, none));
        device->AddMethodDecl(device->AllocateMethodDecl("Stop", TType::kUint32, none));
        disk->AddMethodDecl(disk->AllocateMethodDecl("Format", TType::kUint32, none));
        device->AddQualifier(Qualifier("Version"));
        device->AddQualifier(Qualifier("Units"));
        disk->AddQualifier(Qualifier("Revised"));
        disk->AddQualifier(Qualifier("Deprecated"));
    }

    void Associate(const std::string& name, const std::string& className)
    {
        const auto association = Allocate(name, nullptr);
        association->AddQualifier(Qualifier("Association"));
        association->AddPropertyDecl(Reference("Thing", "Device"));
        association->AddPropertyDecl(Reference("Other", className));
        association->AddToNamespace(none);
    }

    std::vector<TEnumeration> OfTheNamespace()
    {
        return {
            {"root classes", 6, [&](auto& goOn) { ns->EnumerateRootClasses(Ask(goOn), none); }},
            {"qualifier declarations", 3, [&](auto& goOn) { ns->EnumerateQualifierDecls(Ask(goOn), none); }},
            {"answers of a query", 8, [&](auto& goOn) { Query("SELECT * FROM Device", goOn); }},
            {"answers of a query with a condition", 4, [&](auto& goOn) { Query("SELECT * FROM Device WHERE Id LIKE '%2'", goOn); }},
            {"classes below the pseudo-class", 6, [&](auto& goOn) { Root()->EnumerateSubClasses(Ask(goOn), false, none); }},
            {"all classes", 9, [&](auto& goOn) { Root()->EnumerateSubClasses(Ask(goOn), true, none); }},
            {"all instances", 9, [&](auto& goOn) { Root()->EnumerateInstances(Ask(goOn), true, none); }},
        };
    }

    std::vector<TEnumeration> OfAClass()
    {
        return {
            {"subclasses", 3, [&](auto& goOn) { device->EnumerateSubClasses(Ask(goOn), true, none); }},
            {"associated classes", 3, [&](auto& goOn) { device->EnumerateAssociatedClasses(Ask(goOn), "", "", "", "", none); }},
            {"association classes", 3, [&](auto& goOn) { device->EnumerateAssociationClasses(Ask(goOn), "", "", none); }},
            {"key names", 3, [&](auto& goOn) { cabinet->EnumerateKeyNames(Ask(goOn), none); }},
            {"property declarations", 6, [&](auto& goOn) { solidState->EnumeratePropertyDecls(Ask(goOn), none); }},
            {"static properties", 3, [&](auto& goOn) { solidState->EnumerateStaticProperties(Ask(goOn), none); }},
            {"instances", 2, [&](auto& goOn) { device->EnumerateInstances(Ask(goOn), false, none); }},
            {"instances of subclasses too", 8, [&](auto& goOn) { device->EnumerateInstances(Ask(goOn), true, none); }},
            {"method declarations", 3, [&](auto& goOn) { solidState->EnumerateMethodDecls(Ask(goOn), none); }},
            {"qualifiers, inherited ones too", 4, [&](auto& goOn) { disk->EnumerateQualifiers(Ask(goOn), none); }},
        };
    }

    std::vector<TEnumeration> OfAnInstance()
    {
        return {
            {"properties", 3, [&](auto& goOn) { mounted->EnumerateProperties(Ask(goOn), none); }},
            {"key bindings", 3, [&](auto& goOn) { mounted->GetReference(none).EnumerateKeyBindings(Ask(goOn)); }},
        };
    }

    void Query(std::string query, const std::function<bool()>& goOn)
    {
        std::string language = "WQL";
        ns->ExecuteQuery(Ask(goOn), language, query, none);
    }

    // Every enumeration with a callback that ends it at each of its elements in turn, and at none.
    static void ExpectToStopAtOnce(const std::vector<TEnumeration>& enumerations)
    {
        for (const TEnumeration& each : enumerations) {
            for (std::size_t last = 1; last <= each.size + 1; ++last) {
                std::size_t delivered = 0;
                each.run([&] { return ++delivered < last; });
                EXPECT_EQ(std::min(last, each.size), delivered) << each.name << ", to end at number " << last;
            }
        }
    }

    TClassPointer cabinet;
    TInstancePointer mounted;
};

TEST_F(EnumerationTest, OfANamespaceEndsWhereTheCallbackSaysSo)
{
    ExpectToStopAtOnce(OfTheNamespace());
}

TEST_F(EnumerationTest, OfAClassEndsWhereTheCallbackSaysSo)
{
    ExpectToStopAtOnce(OfAClass());
}

TEST_F(EnumerationTest, OfAnInstanceEndsWhereTheCallbackSaysSo)
{
    ExpectToStopAtOnce(OfAnInstance());
}

}  // namespace
}  // namespace NORVZEL20
