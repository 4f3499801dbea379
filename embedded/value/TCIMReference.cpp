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

// For operations that return a reference. Never destroyed: paths may still be read while the process ends.
const std::string& GetEmptyText()
{
    static const std::string* const fgEmpty = new std::string;
    return *fgEmpty;
}

/// The position of the first binding whose name is `name` or comes behind it. There must be one.
std::size_t FindPosition(const TKeyBindings& bindings, const std::string& name)
{
    std::size_t first = 0;
    for (std::size_t last = bindings.GetCount() - 1; first < last;) {
        const std::size_t middle = first + (last - first) / 2;
        if (TNameText::Compare(bindings.GetName(middle), name) < 0) {
            first = middle + 1;
        } else {
            last = middle;
        }
    }
    return first;
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

void LowerFrom(std::string& out, std::size_t start)
{
    const auto from = out.begin() + static_cast<std::ptrdiff_t>(start);
    std::transform(from, out.end(), from, [](char c) { return TNameText::ToLower(c); });
}

// What takes the parts of a path's text (TCIMReference::WriteParts). Nearly all paths have no namespace, and their keys are text
// without anything to escape. The text of such a path is counted first and then put into memory of that length.

/// Counts the characters of such a path.
class TCountingOut {
  public:
    void Put(char) noexcept { ++fLength; }
    void Put(std::string_view text) noexcept { fLength += text.size(); }
    void PutKey(const TCIMValue& value) noexcept
    {
        if (!TValueAccess::IsText(value)) {
            fIsPlain = false;
            fLength += kUsualNumberLength;
            return;
        }
        const std::string_view text = TValueAccess::GetText(value);
        fIsPlain = fIsPlain && !TValueText::NeedsEscape(text, '"');
        fLength += text.size() + 2;
    }
    /// False if a key needs more than quotes. The length is an estimate then.
    bool IsPlain() const noexcept { return fIsPlain; }
    std::size_t GetLength() const noexcept { return fLength; }

  private:
    static constexpr std::size_t kUsualNumberLength = 10;  // a longer number only makes the text grow once

    std::size_t fLength = 0;
    bool fIsPlain = true;
};

/// Writes the text of such a path to memory that has room for it.
class TPlainOut {
  public:
    explicit TPlainOut(char* to) noexcept : fTo(to) {}

    void Put(char c) noexcept { *fTo++ = c; }
    void Put(std::string_view text) noexcept { fTo = std::copy(text.begin(), text.end(), fTo); }
    void PutKey(const TCIMValue& value) noexcept
    {
        Put('"');
        Put(TValueAccess::GetText(value));
        Put('"');
    }

  private:
    char* fTo;
};

}  // namespace

TCIMReference::TCIMReference() : fContents(nullptr) {}

TCIMReference::TCIMReference(TContents* contents) noexcept : fContents(contents) {}

TCIMReference::TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> keys) : fContents(nullptr)
{
    // A path without a namespace is usually made for its text and ends soon. Any other may be stored, and recycled contents could
    // take more memory than it needs. In either case, the path frees the contents if something below throws.
    TCIMReference path(ns ? new TContents : TContents::Make());
    if (ns) {
        TPathFrame::TPlace& place = path.fContents->bindings.OwnFrame().OwnPlace();
        place.ns = ns;
        if (const auto* const located = dynamic_cast<const ILocated*>(ns.get())) {
            place.namespaceName = Trim(located->GetNamespaceName(), "/");
        }
    }
    path.fContents->bindings.Reserve(keys.size());
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
    TKeyBindings& bindings = contents.bindings;
    // Keys mostly come in their order.
    const std::size_t count = bindings.GetCount();
    if (count == 0 || TNameText::Compare(bindings.GetName(count - 1), name) < 0) {
        bindings.Append(name, value);
    } else {
        const std::size_t position = FindPosition(bindings, name);
        if (TNameText::Equal(bindings.GetName(position), name)) {
            bindings.SetValue(position, value);
        } else {
            bindings.Insert(position, name, value);
        }
    }
    contents.depth = std::max(contents.depth, depth);
}

void TCIMReference::EnumerateKeyBindings(const boost::function<bool(std::pair<std::string, TCIMValue>)>& callback) const
{
    const TCIMReference held(*this);  // the callback may change or destroy this path
    if (held.fContents == nullptr) {
        return;
    }
    const TKeyBindings& bindings = held.fContents->bindings;
    for (std::size_t at = 0; at < bindings.GetCount(); ++at) {
        if (!callback({bindings.GetName(at), bindings.GetValue(at)})) {
            return;
        }
    }
}

boost::shared_ptr<ICIMClass> TCIMReference::GetClass() const
{
    const boost::shared_ptr<ICIMClass>* const cls = TContents::FindClass(fContents);
    return cls != nullptr ? *cls : nullptr;
}

void TCIMReference::SetClass(boost::shared_ptr<ICIMClass> cls)
{
    Own().bindings.OwnFrame().cls = std::move(cls);
}

/// Appends the text of any path.
class TCIMReference::TGrowingOut {
  public:
    TGrowingOut(std::string& out, TCIMValue::EKeyForm form) noexcept : fOut(out), fForm(form) {}

    void Put(char c) { fOut += c; }
    void Put(const std::string& text) { fOut += text; }
    void PutKey(const TCIMValue& value) { value.AppendKey(fOut, fForm); }

  private:
    std::string& fOut;
    TCIMValue::EKeyForm fForm;
};

/// The one place that says what a path with a class and keys looks like.
template <class TOut>
void TCIMReference::WriteParts(TOut& out, const std::string& className) const
{
    out.Put(className);
    char separator = '.';
    const TKeyBindings& bindings = fContents->bindings;
    for (std::size_t at = 0; at < bindings.GetCount(); ++at) {
        out.Put(separator);
        out.Put(bindings.GetName(at));
        out.Put('=');
        out.PutKey(bindings.GetValue(at));
        separator = ',';
    }
}

std::string TCIMReference::GetPath() const
{
    std::string path;
    if (fContents == nullptr) {
        return path;
    }
    const std::string& className = GetClassName();
    TCountingOut count;
    WriteParts(count, className);
    if (count.IsPlain() && TContents::FindPlace(fContents) == nullptr) {
        path = std::string(count.GetLength(), '\0');  // cheaper than growing the empty text to that length
        TPlainOut out(path.data());
        WriteParts(out, className);
        return path;
    }
    path.reserve(count.GetLength() + GetHost().size() + GetNamespaceName().size() + std::string_view("///:").size());
    AppendPath(path);
    return path;
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
    if (TContents::FindPlace(fContents) != nullptr) {
        const std::size_t start = out.size();
        AppendPlace(out, GetHost(), GetNamespaceName());
        if (form == TCIMValue::EKeyForm::kCanonical) {
            LowerFrom(out, start);
        }
    }
    TGrowingOut text(out, form);
    WriteParts(text, GetClassName());
}

boost::shared_ptr<ICIMNamespace> TCIMReference::GetNamespace() const
{
    const TPathFrame::TPlace* const place = TContents::FindPlace(fContents);
    return place != nullptr ? place->ns.lock() : nullptr;
}

const std::string& TCIMReference::GetNamespaceName() const
{
    const TPathFrame::TPlace* const place = TContents::FindPlace(fContents);
    return place != nullptr ? place->namespaceName : GetEmptyText();
}

void TCIMReference::SetNamespaceName(const std::string& name)
{
    std::string trimmed(Trim(name, "/"));
    TPathFrame& frame = Own().bindings.OwnFrame();
    TPathFrame::TPlace& place = frame.OwnPlace();
    // The namespace held so far has the old name, so it is not the one that is meant now.
    if (!TNameText::Equal(place.namespaceName, trimmed)) {
        place.ns.reset();
    }
    place.namespaceName = std::move(trimmed);
    frame.DropEmptyPlace();
}

const std::string& TCIMReference::GetHost() const
{
    const TPathFrame::TPlace* const place = TContents::FindPlace(fContents);
    return place != nullptr ? place->host : GetEmptyText();
}

void TCIMReference::SetHost(const std::string& host)
{
    TPathFrame& frame = Own().bindings.OwnFrame();
    frame.OwnPlace().host = host;
    frame.DropEmptyPlace();
}

const std::string& TCIMReference::GetClassName() const
{
    const boost::shared_ptr<ICIMClass>* const cls = TContents::FindClass(fContents);
    return cls != nullptr ? (*cls)->GetName(TCallContext()) : GetEmptyText();
}

void TCIMReference::SetClassName(const std::string& name)
{
    SetClass(name.empty() ? nullptr : boost::make_shared<TStubClass>(name));
}

std::size_t TCIMReference::GetKeyCount() const
{
    return fContents != nullptr ? fContents->bindings.GetCount() : 0;
}

const TCIMValue* TCIMReference::FindKeyValue(const std::string& name) const
{
    if (fContents == nullptr) {
        return nullptr;
    }
    // Paths have few keys, so they are searched from the front.
    const TKeyBindings& bindings = fContents->bindings;
    for (std::size_t at = 0; at < bindings.GetCount(); ++at) {
        if (TNameText::Equal(bindings.GetName(at), name)) {
            return &bindings.GetValue(at);
        }
    }
    return nullptr;
}

}  // namespace NORVZEL20
