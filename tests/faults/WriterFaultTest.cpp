// Writing CIM-XML when memory runs out, and when an instance fails half-way. The same writer must then write a correct document,
// because it keeps a buffer from one call to the next.

#include <gtest/gtest.h>

#include "embedded/cimxml/TCimXmlWriter.h"
#include "host/TZELException.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/support/NoContext.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

/// An instance that fails after it has delivered some of its properties.
class TBrokenInstance : public ICIMInstance {
  public:
    TBrokenInstance(boost::shared_ptr<ICIMInstance> instance, int told) : fInstance(instance), fTold(told) {}

    void Validate(TCallContext context) const override { fInstance->Validate(context); }
    void AddToNamespace(TCallContext context) override { fInstance->AddToNamespace(context); }
    TCIMReference GetReference(TCallContext context) const override { return fInstance->GetReference(context); }
    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override { return fInstance->GetClass(context); }
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override
    {
        return fInstance->GetProperty(name, context);
    }
    void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                             TCallContext context) const override
    {
        int told = 0;
        fInstance->EnumerateProperties(
            [&](boost::shared_ptr<ICIMProperty> property) {
                if (told++ == fTold) {
                    throw TZELException(TZELStatusCode::kNamespaceGone);
                }
                return callback(property);
            },
            context);
    }

  private:
    boost::shared_ptr<ICIMInstance> fInstance;
    int fTold;
};

TEST(WriterFaults, AnInstanceThatTheHostCannotTellIsLeftOutWhole)
{
    TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
    builder.Class("Disk", "", {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Label")});
    const auto good = builder.GetNamespace()->GetClass("Disk", kNoContext)->AllocateInstance(kNoContext);
    good->GetProperty("Id", kNoContext)->SetValue(TCIMValue("a"), kNoContext);
    for (const int told : {0, 1}) {
        std::string text;
        TCimXmlWriter writer([&text](std::string_view piece) { text += piece; });
        writer.StartDocument();
        writer.WriteInstance(*good);
        EXPECT_EQ("status 18", OutcomeOf([&] { writer.WriteInstance(TBrokenInstance(good, told)); }));
        writer.WriteInstance(*good);
        writer.EndDocument();
        const std::string once = "<VALUE.OBJECT>" + TCimXmlWriter::InstanceToXml(*good) + "</VALUE.OBJECT>\n";
        const std::size_t start = text.find("<VALUE.OBJECT>");
        EXPECT_EQ(once + once + "</DECLGROUP></DECLARATION></CIM>\n", text.substr(start)) << told;
    }
}

/// Writes a whole namespace. After a failure the same writer writes it again.
class TWriteNamespace : public IFaultyAction {
  public:
    explicit TWriteNamespace(boost::shared_ptr<ICIMNamespace> ns) : fNamespace(ns)
    {
        fWriter.WriteNamespace(*fNamespace);
        fWhole.swap(fText);
    }

    void Act() override { fWriter.WriteNamespace(*fNamespace); }

    void Verify(const std::string& outcome) override
    {
        if (!outcome.empty()) {
            EXPECT_EQ("bad_alloc", outcome);
            EXPECT_EQ(fWhole.substr(0, fText.size()), fText);
            fText.clear();
            fWriter.WriteNamespace(*fNamespace);
        }
        EXPECT_EQ(fWhole, fText);
    }

  private:
    boost::shared_ptr<ICIMNamespace> fNamespace;
    std::string fText;
    std::string fWhole;
    TCimXmlWriter fWriter{[this](std::string_view piece) { fText += piece; }};
};

TEST(WriterFaults, WithoutMemoryTheDocumentBreaksOffAndCanBeWrittenAgain)
{
    TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
    FillDiffering(builder, 0);
    const auto ns = builder.GetNamespace();
    EXPECT_EQ("bad_alloc", FailEachAllocation("WriteNamespace", [&] { return std::make_unique<TWriteNamespace>(ns); }));
}

}  // namespace
}  // namespace NORVZEL20
