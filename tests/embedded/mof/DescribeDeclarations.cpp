#include "tests/embedded/mof/DescribeDeclarations.h"

#include <algorithm>
#include <vector>

#include "embedded/store/TInMemClass.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TLines = std::vector<std::string>;

std::string DescribeMofValue(const TCIMValue& value)
{
    return TValueText::DescribeType(value.GetType()) + (value.IsNull() ? " NULL" : " '" + value.ToText() + "'");
}

template <class TElement>
void AddQualifierLines(TLines& lines, const std::string& prefix, const TElement& element)
{
    const auto add = [&](const boost::shared_ptr<ICIMQualifier>& qualifier) {
        lines.push_back(prefix + " [" + TNameText::ToLower(qualifier->GetName(TCallContext())) + "] " +
                        DescribeMofValue(qualifier->GetValue(TCallContext())) + " flavor " +
                        std::to_string(qualifier->GetFlavor(TCallContext())));
        return true;
    };
    element.EnumerateQualifiers(add, TCallContext());
}

std::string DescribeType(TCIMValue::TCIMType type, const std::string& referenceClass, unsigned int size)
{
    return TValueText::DescribeType(type) + (referenceClass.empty() ? "" : " to " + TNameText::ToLower(referenceClass)) +
           (size == 0 ? "" : " of " + std::to_string(size));
}

void AddPropertyLines(TLines& lines, const std::string& prefix, const TInMemPropertyDecl& decl)
{
    lines.push_back(prefix + " " + DescribeType(decl.GetType(), decl.GetReferenceClass(), decl.GetArraySize()) + " = " +
                    DescribeMofValue(decl.GetDefaultValue()) + (decl.IsKey() ? " key" : ""));
    AddQualifierLines(lines, prefix, decl);
}

void AddMethodLines(TLines& lines, const std::string& prefix, const TInMemMethodDecl& decl)
{
    lines.push_back(prefix + " " + TValueText::DescribeType(decl.GetType(TCallContext())));
    AddQualifierLines(lines, prefix, decl);
    std::size_t number = 0;
    for (const boost::shared_ptr<TInMemParameter>& parameter : decl.GetParameters()) {
        const std::string inner = prefix + " " + std::to_string(number++) + " " + parameter->GetName();
        lines.push_back(inner + " " +
                        DescribeType(parameter->GetType(), parameter->GetReferenceClass(), parameter->GetArraySize()));
        AddQualifierLines(lines, inner, *parameter);
    }
}

void AddClassLines(TLines& lines, const TInMemClass& cls)
{
    const boost::shared_ptr<TInMemClass> super = cls.GetSuperInMemClass();
    const std::string prefix = "class " + cls.GetName();
    lines.push_back(prefix + " : " + (super ? super->GetName() : ""));
    AddQualifierLines(lines, prefix, cls);
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const TInMemPropertyDecl& decl = cls.GetLayout().GetDecl(slot);
        AddPropertyLines(lines, prefix + "." + TNameText::ToLower(decl.GetName()), decl);
    }
    const auto addMethod = [&](const boost::shared_ptr<ICIMMethodDecl>& decl) {
        AddMethodLines(lines, prefix + "." + TNameText::ToLower(decl->GetName(TCallContext())) + "()",
                       dynamic_cast<const TInMemMethodDecl&>(*decl));
        return true;
    };
    cls.EnumerateMethodDecls(addMethod, TCallContext());
}

void AddClassTreeLines(TLines& lines, ICIMClass& cls)
{
    const auto add = [&](const boost::shared_ptr<ICIMClass>& sub) {
        AddClassLines(lines, dynamic_cast<const TInMemClass&>(*sub));
        AddClassTreeLines(lines, *sub);
        return true;
    };
    cls.EnumerateSubClasses(add, false, TCallContext());
}

TLines DescribeDeclarations(TInMemNamespace& ns, const std::string& ignored)
{
    TLines lines;
    const auto addQualifier = [&](const boost::shared_ptr<ICIMQualifierDecl>& decl) {
        lines.push_back("qualifier " + decl->GetName(TCallContext()) + " " + DescribeMofValue(decl->GetValue(TCallContext())) +
                        " scope " + std::to_string(decl->GetScope(TCallContext())) + " flavor " +
                        std::to_string(decl->GetFlavor(TCallContext())));
        return true;
    };
    ns.EnumerateQualifierDecls(addQualifier, TCallContext());
    AddClassTreeLines(lines, *ns.GetClass("<root>", TCallContext()));
    for (std::string& line : lines) {
        const auto isIgnored = [&](char c) { return ignored.find(c) != std::string::npos; };
        line.erase(std::remove_if(line.begin(), line.end(), isIgnored), line.end());
        std::replace(line.begin(), line.end(), '\n', '|');
    }
    std::sort(lines.begin(), lines.end());
    return lines;
}

}  // namespace

std::string DiffDeclarations(TInMemNamespace& left, TInMemNamespace& right, const std::string& ignored)
{
    const TLines lefts = DescribeDeclarations(left, ignored);
    const TLines rights = DescribeDeclarations(right, ignored);
    std::string text;
    auto a = lefts.begin();
    auto b = rights.begin();
    while (a != lefts.end() || b != rights.end()) {
        if (b == rights.end() || (a != lefts.end() && *a < *b)) {
            text += "- " + *a++ + "\n";
        } else if (a == lefts.end() || *b < *a) {
            text += "+ " + *b++ + "\n";
        } else {
            ++a;
            ++b;
        }
    }
    return text;
}

}  // namespace NORVZEL20
