#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>
#include <typeinfo>

#include "embedded/services/TAssertionFailure.h"
#include "host/TZELException.h"
#include "spec/TDiffXMLParser.h"
#include "tests/spec/SpecDocuments.h"
#include "tests/spec/TSpecFixture.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

/// A specification that is read against a schema that does not do what schemas do.
class BrokenSchemaTest : public TSpecFixture, public testing::WithParamInterface<EHost> {
  protected:
    BrokenSchemaTest() : TSpecFixture(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(Hosts, BrokenSchemaTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

struct TSpecialException : TZELException {
    using TZELException::TZELException;
};

// A schema that answers a number of calls and then throws.
template <typename TFailure>
class TFadingSchema : public TWatchedNamespace {
  public:
    TFadingSchema(boost::shared_ptr<ICIMNamespace> ns, int answers, const TFailure& failure)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "fading"), fAnswers(answers), fFailure(failure)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        if (--fAnswers < 0) {
            throw fFailure;
        }
        return TWatchedNamespace::GetClass(name, context);
    }

  private:
    int fAnswers;
    TFailure fFailure;
};

class FadingSchemaTest : public BrokenSchemaTest {
  protected:
    // From now on the schema answers for that many classes.
    template <typename TFailure>
    void FadeAfter(int answers, const TFailure& failure)
    {
        fNamespaces[0] = boost::make_shared<TFadingSchema<TFailure>>(fComparison.Namespace(0).GetNamespace(), answers, failure);
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, FadingSchemaTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(FadingSchemaTest, AFailureIsThrownAnew)
{
    FadeAfter(1, TSpecialException(TZELStatusCode::kNamespaceGone));
    TCIMDiffEngine::TDiffXMLParser parser(fNamespaces[0]);
    std::map<std::string, std::string> attrs;
    parser.StartElement("DifftoolSpec", attrs);
    attrs["name"] = "Other";
    parser.StartElement("class", attrs);
    try {
        parser.EndElement("class");
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
        EXPECT_EQ(typeid(TZELException), typeid(error));
    }
}

TEST_P(FadingSchemaTest, WhatIsNoExceptionOfTheHostPassesWithoutAWordInTheLog)
{
    const std::string document = InValue("A");
    for (const int answers : {0, 1, 2}) {  // in the start tag of the class, the end tag of the value, the end tag of the class
        FadeAfter(answers, std::runtime_error("own"));
        EXPECT_THROW(Read(document), std::runtime_error) << answers;
        FadeAfter(answers, 5);
        EXPECT_THROW(Read(document), int) << answers;
        EXPECT_EQ("", TakeLog()) << answers;
    }
    FadeAfter(3, 5);
    EXPECT_EQ("Other exclude A:INCLUDE\n", Read(document));
}

// A schema that answers a number of calls and then returns a null class.
class TEmptyingSchema : public TWatchedNamespace {
  public:
    TEmptyingSchema(boost::shared_ptr<ICIMNamespace> ns, int answers)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "emptying"), fAnswers(answers)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        return --fAnswers < 0 ? nullptr : TWatchedNamespace::GetClass(name, context);
    }

  private:
    int fAnswers;
};

TEST_P(BrokenSchemaTest, ANullSchemaFailsTheAssertionAtTheFirstClass)
{
    fNamespaces[0] = nullptr;
    EXPECT_EQ("", Read("<DifftoolSpec/>"));
    EXPECT_THROW(Read("<DifftoolSpec><class name=\"Other\"/></DifftoolSpec>"), TAssertionFailure);
    EXPECT_EQ(0u, TakeLog().find("0|Assertion failed: px != 0"));
}

TEST_P(BrokenSchemaTest, ANullClassFailsTheAssertionWhereItIsAskedForMore)
{
    for (const int answers : {0, 1, 2}) {  // a class element asks for no more than its class
        fNamespaces[0] = boost::make_shared<TEmptyingSchema>(fComparison.Namespace(0).GetNamespace(), answers);
        EXPECT_THROW(Read(InValue("A")), TAssertionFailure) << answers;
        const std::string log = TakeLog();
        EXPECT_EQ(0u, log.find("0|Assertion failed: px != 0")) << answers;
        EXPECT_EQ(std::string::npos, log.find("exception in")) << answers;
    }
}

// A schema whose class Other returns a null pointer for every declaration of a property.
class TUndeclaringSchema : public TWatchedNamespace {
  public:
    explicit TUndeclaringSchema(boost::shared_ptr<ICIMNamespace> ns)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "undeclaring")
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        return boost::make_shared<TUndeclaringClass>(TWatchedNamespace::GetClass(name, context));
    }

  private:
    class TUndeclaringClass : public TWatchedClass {
      public:
        explicit TUndeclaringClass(boost::shared_ptr<ICIMClass> cls)
            : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "undeclaring")
        {}

        boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string&, TCallContext) const override { return nullptr; }
    };
};

TEST_P(BrokenSchemaTest, OnlyAnExceptionMakesAPropertyInvalid)
{
    fNamespaces[0] = boost::make_shared<TUndeclaringSchema>(fComparison.Namespace(0).GetNamespace());
    EXPECT_EQ("Other exclude Z:INCLUDE\n", Read(InValue("Z")));
    EXPECT_EQ("", TakeLog());
}

}  // namespace
}  // namespace NORVZEL20
