#include <cxxabi.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <type_traits>
#include <typeinfo>

#include "engine/TCompareInstances.h"
#include "provider/TCallbackWrapClass.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespace.h"
#include "provider/TDeltaNamespaceProvider.h"

namespace NORVZEL20 {
namespace {

std::string NameOf(const std::type_info& type)
{
    int status = 0;
    const std::unique_ptr<char, void (*)(void*)> name(abi::__cxa_demangle(type.name(), nullptr, nullptr, &status), &std::free);
    return name.get();
}

// The bases in the order of declaration, read from the type information. The layout does not show that order, because a base with
// virtual operations always comes first.
std::string BasesOf(const std::type_info& type)
{
    std::string text;
    if (const auto* const several = dynamic_cast<const abi::__vmi_class_type_info*>(&type)) {
        for (unsigned int index = 0; index < several->__base_count; ++index) {
            const auto& base = several->__base_info[index];
            text += std::string(base.__is_public_p() ? "public " : "") + NameOf(*base.__base_type) + "\n";
        }
    } else if (const auto* const one = dynamic_cast<const abi::__si_class_type_info*>(&type)) {
        text = "public " + NameOf(*one->__base_type) + "\n";
    }
    return text;
}

TEST(BasesTest, OfTheInterfaceOfClasses)
{
    EXPECT_EQ("", BasesOf(typeid(ICIMElement)));
    EXPECT_EQ("", BasesOf(typeid(ICIMNamedElement)));
    EXPECT_EQ("public NORVZEL20::ICIMElement\n"
              "public NORVZEL20::ICIMNamedElement\n",
              BasesOf(typeid(ICIMClass)));
}

TEST(BasesTest, OfTheDeltaNamespace)
{
    EXPECT_EQ("public NORVZEL20::ICIMNamespace\n"
              "public boost::enable_shared_from_this<NORVZEL20::TDeltaNamespace>\n",
              BasesOf(typeid(TDeltaNamespace)));
    EXPECT_EQ("", BasesOf(typeid(ICIMNamespace)));
}

TEST(BasesTest, OfTheClassWrapper)
{
    EXPECT_EQ("public NORVZEL20::ICIMClass\n"
              "public boost::enable_shared_from_this<NORVZEL20::TDeltaClass>\n",
              BasesOf(typeid(TDeltaClass)));
}

TEST(BasesTest, OfTheProvider)
{
    EXPECT_EQ("public NORVZEL20::INamespaceProvider\n", BasesOf(typeid(TDeltaNamespaceProvider)));
    EXPECT_EQ("", BasesOf(typeid(INamespaceProvider)));
}

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wdeprecated-declarations"
template <class TArgument>
using TStandardBase = std::unary_function<TArgument, bool>;
#pragma GCC diagnostic pop

TEST(BasesTest, OfTheCallbacks)
{
    using TClass = boost::shared_ptr<ICIMClass>;
    using TInstance = boost::shared_ptr<ICIMInstance>;
    EXPECT_TRUE((std::is_convertible_v<TCallbackWrapClass*, TStandardBase<TClass>*>));
    EXPECT_TRUE((std::is_same_v<TClass, TCallbackWrapClass::argument_type>));
    EXPECT_TRUE((std::is_convertible_v<TCIMDiffEngine::TCompareInstances*, TStandardBase<TInstance>*>));
    EXPECT_TRUE((std::is_same_v<TInstance, TCIMDiffEngine::TCompareInstances::argument_type>));
}

}  // namespace
}  // namespace NORVZEL20
