// An object path: which class or instance of which namespace.
//
// A path is a pointer to counted contents: namespace and host, the class, and the key bindings in the order of their names in
// lower case. Copies share the contents; an operation that changes a path first makes sure that no other path uses them (Own).
//
// The text is `//host/namespace:Class.Key="value",Other=5`. Text, datetimes, embedded objects and the paths of references are in
// double quotes, char16 in single quotes. Only two characters are escaped, each by a backslash in front of it: the backslash and
// the quote that is in use. Because bindings are sorted and escaped, paths with different bindings have different texts. Because
// values that can be written in several ways are written in one (TCIMValue::AppendKey), equal keys have equal texts. So a text can
// decide whether two references are equal and can be the key under which an instance is found.

#include "host/TCIMReference.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/value/ILocated.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TReferenceContents.h"
#include "embedded/value/TStubClass.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "embedded/value/Trim.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

// An estimate: a longer number only makes the text grow once.
constexpr std::size_t kUsualNumberLength = 10;

// For operations that return a reference. Never destroyed: paths may still be read while the process ends.
const std::string& GetEmptyText()
{
    static const std::string* const fgEmpty = new std::string;
    return *fgEmpty;
}

void AppendPlace(std::string& out, const std::string& host, const std::string& namespaceName)
{
    if (!host.empty()) {
        out.append("//").append(host).append(1, '/');
    }
    if (!namespaceName.empty()) {
        out.append(namespaceName).append(1, ':');
    }
}

/// Copies `text` to `to` and returns the place behind it.
char* Put(char* to, std::string_view text) noexcept
{
    return std::copy(text.begin(), text.end(), to);
}

void LowerFrom(std::string& out, std::size_t start)
{
    const auto from = out.begin() + static_cast<std::ptrdiff_t>(start);
    std::transform(from, out.end(), from, [](char c) { return TNameText::ToLower(c); });
}

}  // namespace

TCIMReference::TCIMReference() : fContents(nullptr) {}

TCIMReference::TCIMReference(TContents* contents) noexcept : fContents(contents) {}

TCIMReference::TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> keys) : fContents(nullptr)
{
    // A path without a namespace is usually made for its text and ends soon. Any other may be stored, and recycled contents could
    // take more memory than it needs. In either case, the path frees the contents if something below throws.
    TCIMReference path(ns ? new TContents : TContents::Make());
    if (ns) {
        TContents::TPlace& place = path.fContents->OwnPlace();
        place.ns = ns;
        if (const auto* const located = dynamic_cast<const ILocated*>(ns.get())) {
            place.namespaceName = Trim(located->GetNamespaceName(), "/");
        }
    }
    path.fContents->bindings.reserve(keys.size());
    for (const auto& [name, value] : keys) {
        path.AddKeyValue(name, value);
    }
    std::swap(fContents, path.fContents);
}

TCIMReference::TCIMReference(const TCIMReference& other) noexcept : fContents(other.fContents)
{
    if (fContents != nullptr) {
        fContents->Acquire();
    }
}

TCIMReference& TCIMReference::operator=(const TCIMReference& other) noexcept
{
    // Acquires before it releases, so a path may be assigned to itself.
    TCIMReference copy(other);
    std::swap(fContents, copy.fContents);
    return *this;
}

TCIMReference::~TCIMReference()
{
    if (fContents != nullptr) {
        TContents::Drop(fContents);
    }
}

/// The contents, used by this path alone and ready to be changed.
TCIMReference::TContents& TCIMReference::Own()
{
    if (fContents == nullptr) {
        fContents = new TContents;
    } else if (!fContents->IsUnique()) {
        // The swap gives up the use of the shared contents after the copy has succeeded.
        TCIMReference copy(new TContents(*fContents));
        std::swap(fContents, copy.fContents);
    }
    return *fContents;
}

void TCIMReference::AddKeyValue(const std::string& name, const TCIMValue& value)
{
    // Checked first, so a value that is refused changes nothing.
    const unsigned int depth = TContents::GetDepth(value);
    if (depth > TContents::kMaxDepth) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    TContents& contents = Own();
    auto& bindings = contents.bindings;
    // Keys mostly come in their order.
    if (bindings.empty() || TNameText::Compare(bindings.back().first, name) < 0) {
        bindings.emplace_back(name, value);
        contents.depth = std::max(contents.depth, depth);
        return;
    }
    const auto place =
        std::lower_bound(bindings.begin(), bindings.end(), name, [](const TContents::TBinding& binding, const std::string& wanted) {
            return TNameText::Compare(binding.first, wanted) < 0;
        });
    if (place != bindings.end() && TNameText::Equal(place->first, name)) {
        place->second = value;
    } else {
        bindings.emplace(place, name, value);
    }
    contents.depth = std::max(contents.depth, depth);
}

void TCIMReference::EnumerateKeyBindings(const boost::function<bool(std::pair<std::string, TCIMValue>)>& callback) const
{
    const TCIMReference held(*this);  // the callback may change or destroy this path
    if (held.fContents == nullptr) {
        return;
    }
    for (const TContents::TBinding& binding : held.fContents->bindings) {
        if (!callback(binding)) {
            return;
        }
    }
}

boost::shared_ptr<ICIMClass> TCIMReference::GetClass() const
{
    return fContents != nullptr ? fContents->cls : nullptr;
}

void TCIMReference::SetClass(boost::shared_ptr<ICIMClass> cls)
{
    Own().cls = std::move(cls);
}

std::string TCIMReference::GetPath() const
{
    std::string path;
    if (!MakePlainPath(path)) {
        path.reserve(EstimateLength());
        AppendPath(path);
    }
    return path;
}

/// Makes the text of a path without namespace whose keys are all text without anything to escape, as nearly all are: in one block
/// of the right size. Returns false for other paths.
bool TCIMReference::MakePlainPath(std::string& path) const
{
    if (fContents == nullptr || fContents->place) {
        return false;
    }
    const std::string& className = GetClassName();
    std::size_t length = className.size();
    for (const TContents::TBinding& binding : fContents->bindings) {
        if (!TValueAccess::IsText(binding.second)) {
            return false;
        }
        const std::string_view text = TValueAccess::GetText(binding.second);
        if (TValueText::NeedsEscape(text, '"')) {
            return false;
        }
        length += binding.first.size() + text.size() + std::string_view(".=\"\"").size();
    }
    path = std::string(length, '\0');  // cheaper than growing the empty text to that length
    char* to = Put(path.data(), className);
    char separator = '.';
    for (const TContents::TBinding& binding : fContents->bindings) {
        *to++ = separator;
        to = Put(to, binding.first);
        *to++ = '=';
        *to++ = '"';
        to = Put(to, TValueAccess::GetText(binding.second));
        *to++ = '"';
        separator = ',';
    }
    return true;
}

std::size_t TCIMReference::EstimateLength() const
{
    std::size_t length = GetHost().size() + GetNamespaceName().size() + GetClassName().size() + 4;
    for (std::size_t i = 0; i < GetKeyCount(); ++i) {
        const auto& [name, value] = fContents->bindings[i];
        length += name.size() + 4 + (TValueAccess::IsText(value) ? TValueAccess::GetText(value).size() : kUsualNumberLength);
    }
    return length;
}

void TCIMReference::AppendPath(std::string& out) const
{
    AppendText(out, TCIMValue::EKeyForm::kCanonical);
}

std::string TCIMReference::ToText() const
{
    std::string text;
    AppendText(text, TCIMValue::EKeyForm::kWritten);
    return text;
}

void TCIMReference::AppendText(std::string& out, TCIMValue::EKeyForm form) const
{
    if (fContents == nullptr) {
        return;
    }
    if (fContents->place) {
        const std::size_t start = out.size();
        AppendPlace(out, GetHost(), GetNamespaceName());
        if (form == TCIMValue::EKeyForm::kCanonical) {
            LowerFrom(out, start);
        }
    }
    out += GetClassName();
    char separator = '.';
    for (const TContents::TBinding& binding : fContents->bindings) {
        out.append(1, separator).append(binding.first).append(1, '=');
        binding.second.AppendKey(out, form);
        separator = ',';
    }
}

boost::shared_ptr<ICIMNamespace> TCIMReference::GetNamespace() const
{
    return fContents != nullptr && fContents->place ? fContents->place->ns.lock() : nullptr;
}

const std::string& TCIMReference::GetNamespaceName() const
{
    return fContents != nullptr && fContents->place ? fContents->place->namespaceName : GetEmptyText();
}

void TCIMReference::SetNamespaceName(const std::string& name)
{
    std::string trimmed(Trim(name, "/"));
    TContents::TPlace& place = Own().OwnPlace();
    // The namespace held so far has the old name, so it is not the one that is meant now.
    if (!TNameText::Equal(place.namespaceName, trimmed)) {
        place.ns.reset();
    }
    place.namespaceName = std::move(trimmed);
    fContents->DropEmptyPlace();
}

const std::string& TCIMReference::GetHost() const
{
    return fContents != nullptr && fContents->place ? fContents->place->host : GetEmptyText();
}

void TCIMReference::SetHost(const std::string& host)
{
    TContents& contents = Own();
    contents.OwnPlace().host = host;
    contents.DropEmptyPlace();
}

const std::string& TCIMReference::GetClassName() const
{
    return fContents != nullptr && fContents->cls ? fContents->cls->GetName(TCallContext()) : GetEmptyText();
}

void TCIMReference::SetClassName(const std::string& name)
{
    SetClass(name.empty() ? nullptr : boost::make_shared<TStubClass>(name));
}

std::size_t TCIMReference::GetKeyCount() const
{
    return fContents != nullptr ? fContents->bindings.size() : 0;
}

const TCIMValue* TCIMReference::FindKeyValue(const std::string& name) const
{
    if (fContents == nullptr) {
        return nullptr;
    }
    const auto& bindings = fContents->bindings;
    // Paths have few keys, so they are searched from the front.
    const auto found = std::find_if(bindings.begin(), bindings.end(),
                                    [&name](const TContents::TBinding& binding) { return TNameText::Equal(binding.first, name); });
    return found != bindings.end() ? &found->second : nullptr;
}

}  // namespace NORVZEL20
