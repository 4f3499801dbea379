#include "host/TNamespacePopulator.h"
#include "provider/TDeltaClass.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {
namespace {

const std::string kIsTrue = "TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";

std::string ClassXml(const std::string& name, const std::string& superClass, const std::string& inner)
{
    return "<VALUE.OBJECT><CLASS NAME=\"" + name + "\"" + (superClass.empty() ? "" : " SUPERCLASS=\"" + superClass + "\"") + ">" +
           inner + "</CLASS></VALUE.OBJECT>";
}

std::string ReferenceXml(const std::string& name, const std::string& cls)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\" REFERENCECLASS=\"" + cls + "\"><QUALIFIER NAME=\"Key\" " + kIsTrue +
           "</PROPERTY.REFERENCE>";
}

// Two namespaces of the embedded host. Both have Disk > Ssd and Room; only the second one connects them, by Location.
class AssociationsTest : public testing::Test {
  protected:
    AssociationsTest() : fComparison(EHost::kInmem)
    {
        const std::string key = "<PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" " + kIsTrue + "</PROPERTY>";
        const std::string things = ClassXml("Disk", "", key) + ClassXml("Ssd", "Disk", "") + ClassXml("Room", "", key);
        Load(0, things);
        Load(1, things + ClassXml("Location", "",
                                  "<QUALIFIER NAME=\"Association\" " + kIsTrue + ReferenceXml("Thing", "Disk") +
                                      ReferenceXml("Place", "Room")));
        fComparison.Prepare();
    }

    boost::shared_ptr<ICIMClass> Wrapper(const std::string& name, unsigned short index)
    {
        return fComparison.Delta().GetClass(name, At(index));
    }

    // The associated classes that are the delta namespace's wrappers for this position.
    std::string Associated(const std::string& name, unsigned short index, const std::string& role = "")
    {
        std::string names;
        Wrapper(name, index)->EnumerateAssociatedClasses(Collect(names, index), "", "", role, "", At(index));
        return names;
    }

    std::string Associations(const std::string& name, unsigned short index, const std::string& role = "")
    {
        std::string names;
        Wrapper(name, index)->EnumerateAssociationClasses(Collect(names, index), "", role, At(index));
        return names;
    }

    static TCallContext At(unsigned short index)
    {
        TCallContext context;
        context["nsIndex"] = TCIMValue(index);
        return context;
    }

  private:
    void Load(std::size_t index, const std::string& classes)
    {
        const TScratchFile file("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>" + classes +
                                "</DECLGROUP></DECLARATION></CIM>");
        TNamespacePopulator::PopulateFromXMLFile(fComparison.Namespace(index).GetNamespace(), file.GetPath());
    }

    boost::function<bool(boost::shared_ptr<ICIMClass>)> Collect(std::string& names, unsigned short index)
    {
        return [this, &names, index](boost::shared_ptr<ICIMClass> cls) {
            const std::string name = cls->GetName(TCallContext());
            const bool isWrapper = boost::dynamic_pointer_cast<TDeltaClass>(cls) != nullptr && cls == Wrapper(name, index);
            names += name + (isWrapper ? " " : " (no wrapper) ");
            return true;
        };
    }

    TComparisonRun fComparison;
};

TEST_F(AssociationsTest, AssociatedClassesOfTheEmbeddedHostAreWrappers)
{
    EXPECT_EQ("Room ", Associated("Disk", 1));
    EXPECT_EQ("Room ", Associated("Ssd", 1));
    EXPECT_EQ("Disk ", Associated("Room", 1));
    EXPECT_EQ("Room ", Associated("Disk", 1, "Thing"));
    EXPECT_EQ("", Associated("Disk", 1, "Place"));
    EXPECT_EQ("", Associated("Disk", 0));
}

TEST_F(AssociationsTest, AssociationClassesOfTheEmbeddedHostAreWrappers)
{
    EXPECT_EQ("Location ", Associations("Disk", 1));
    EXPECT_EQ("Location ", Associations("Room", 1, "Place"));
    EXPECT_EQ("", Associations("Room", 1, "Thing"));
    EXPECT_EQ("", Associations("Disk", 0));
    EXPECT_TRUE(Wrapper("Location", 1)->IsAssociation(At(1)));
    EXPECT_FALSE(Wrapper("Disk", 1)->IsAssociation(At(1)));
}

}  // namespace
}  // namespace NORVZEL20
