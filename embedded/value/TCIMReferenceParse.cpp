// Reads the text of an object path:
//
//     path     = [ "//" host "/" | "/" ] [ namespace ":" ] [ class ] [ "." binding *( "," binding ) | "=@" ]
//     binding  = key "=" value
//     value    = `"` text `"` | "'" character "'" | number | "TRUE" | "FALSE" | "NULL"
//
// In quotes a backslash makes the next character part of the text, even a quote. A value without quotes ends at the next comma.
// The namespace ends at the first colon; if an equals sign or a quote comes before it, the colon belongs to a value and there is
// no namespace. A path without a class must have bindings, and no key may occur twice. "=@" marks the one instance of a class
// without keys.

#include <algorithm>

#include "embedded/value/TNameText.h"
#include "embedded/value/TReferenceContents.h"
#include "embedded/value/TStubClass.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "host/ICIMClass.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// Reads a text from front to back. After a failure the position is that of the first wrong byte.
class TPathReader {
  public:
    struct TBinding {
        std::string name;
        TCIMValue value;
        std::size_t position;
    };

    explicit TPathReader(std::string_view text) : fText(text) {}

    void Read()
    {
        ReadHost();
        ReadNamespace();
        fClassName = ReadName();
        if (fClassName.empty() && Peek() != '.') {
            Fail();
        }
        if (fText.substr(fPosition) == "=@") {
            return;
        }
        if (fPosition < fText.size()) {
            Expect('.');
            ReadBindings();
        }
        SortBindings();
    }

    std::string_view GetHost() const { return fHost; }
    std::string_view GetNamespaceName() const { return fNamespaceName; }
    std::string_view GetClassName() const { return fClassName; }
    std::vector<TBinding>& GetBindings() { return fBindings; }
    std::size_t GetPosition() const { return fPosition; }

  private:
    [[noreturn]] static void Fail() { throw TZELException(TZELStatusCode::kParseError); }

    char Peek() const { return fPosition < fText.size() ? fText[fPosition] : '\0'; }

    void Expect(char c)
    {
        if (fPosition >= fText.size() || fText[fPosition] != c) {
            Fail();
        }
        ++fPosition;
    }

    void ReadHost()
    {
        if (fText.substr(0, 2) != "//") {
            fPosition = Peek() == '/' ? 1 : 0;
            return;
        }
        fPosition = 2;
        const std::size_t end = fText.find('/', fPosition);
        if (end == std::string_view::npos || end == fPosition) {
            Fail();
        }
        fHost = fText.substr(fPosition, end - fPosition);
        fPosition = end + 1;
    }

    /// Class names have no colon, so a colon in front of every binding ends a namespace.
    void ReadNamespace()
    {
        const std::size_t end = fText.find_first_of(":='\"", fPosition);
        if (end != std::string_view::npos && fText[end] == ':') {
            fNamespaceName = fText.substr(fPosition, end - fPosition);
            fPosition = end + 1;
        }
    }

    std::string_view ReadName()
    {
        const std::size_t start = fPosition;
        if (TNameText::IsNameStart(Peek())) {
            while (TNameText::IsNamePart(Peek())) {
                ++fPosition;
            }
        }
        return fText.substr(start, fPosition - start);
    }

    void ReadBindings()
    {
        while (true) {
            const std::size_t start = fPosition;
            const std::string_view name = ReadName();
            if (name.empty()) {
                Fail();
            }
            Expect('=');
            fBindings.push_back({std::string(name), ReadValue(), start});
            if (fPosition == fText.size()) {
                return;
            }
            Expect(',');
        }
    }

    TCIMValue ReadValue()
    {
        const std::size_t start = fPosition;
        if (Peek() == '"') {
            return TCIMValue(ReadQuoted('"'));
        }
        TCIMValue value;
        const bool isRead =
            Peek() == '\'' ? TValueText::Parse(TCIMValue::TCIMType::kChar16, ReadQuoted('\''), value) : ReadWord(value);
        if (!isRead) {
            // The whole value is wrong, so the position is that of its first byte.
            fPosition = start;
            Fail();
        }
        return value;
    }

    std::string ReadQuoted(char quote)
    {
        std::string text;
        const char stops[] = {quote, '\\'};
        for (++fPosition;;) {
            const std::size_t stop = fText.find_first_of(std::string_view(stops, 2), fPosition);
            if (stop == std::string_view::npos || (fText[stop] == '\\' && stop + 1 == fText.size())) {
                fPosition = fText.size();
                Fail();
            }
            text += fText.substr(fPosition, stop - fPosition);
            fPosition = stop + 1;
            if (fText[stop] == quote) {
                return text;
            }
            // The character behind a backslash is text, even if it is a quote.
            text += fText[fPosition++];
        }
    }

    /// The text does not say which type a key has. A number gets the first of uint64, sint64 and real64 that can hold it; the store
    /// converts it when it looks for the instance.
    bool ReadWord(TCIMValue& value)
    {
        const std::size_t end = std::min(fText.find(',', fPosition), fText.size());
        const std::string_view word = fText.substr(fPosition, end - fPosition);
        fPosition = end;
        if (TNameText::Equal(word, "NULL")) {
            return true;
        }
        using TType = TCIMValue::TCIMType;
        if (TValueText::Parse(TType::kBoolean, word, value)) {
            return true;
        }
        const bool hasSign = !word.empty() && (word[0] == '+' || word[0] == '-');
        return TValueText::Parse(hasSign ? TType::kSint64 : TType::kUint64, word, value) ||
               TValueText::Parse(TType::kReal64, word, value);
    }

    /// Sorts all bindings at once, because inserting them one by one would take quadratic time for a path of many keys.
    void SortBindings()
    {
        std::stable_sort(fBindings.begin(), fBindings.end(),
                         [](const TBinding& a, const TBinding& b) { return TNameText::Compare(a.name, b.name) < 0; });
        const auto repeated = std::adjacent_find(fBindings.begin(), fBindings.end(), [](const TBinding& a, const TBinding& b) {
            return TNameText::Equal(a.name, b.name);
        });
        if (repeated != fBindings.end()) {
            fPosition = std::next(repeated)->position;
            Fail();
        }
    }

    std::string_view fText;
    std::size_t fPosition = 0;
    std::string_view fHost;
    std::string_view fNamespaceName;
    std::string_view fClassName;
    std::vector<TBinding> fBindings;
};

/// Null if the namespace does not declare the class.
boost::shared_ptr<ICIMClass> FindClass(ICIMNamespace& ns, const std::string& name)
{
    try {
        return ns.GetClass(name, TCallContext());
    } catch (const TZELException& failure) {
        if (failure.GetStatusCode() != TZELStatusCode::kNotFound) {
            throw;
        }
        return nullptr;
    }
}

/// Null if the class does not declare the property.
boost::shared_ptr<ICIMPropertyDecl> FindProperty(const ICIMClass& cls, const std::string& name)
{
    try {
        return cls.GetPropertyDecl(name, TCallContext());
    } catch (const TZELException& failure) {
        if (failure.GetStatusCode() != TZELStatusCode::kNotFound) {
            throw;
        }
        return nullptr;
    }
}

/// The path that a key's text holds, in the spelling of its class; the text itself if it holds none.
TCIMValue ReadPath(const TCIMValue& text, const boost::shared_ptr<ICIMNamespace>& ns)
{
    try {
        return TCIMValue(TCIMReference::Parse(std::string(text.GetString()), ns));
    } catch (const TZELException& failure) {
        if (failure.GetStatusCode() != TZELStatusCode::kParseError) {
            throw;
        }
        return text;
    }
}

/// Gives a key the declared spelling and type, if its value converts.
void Adapt(TPathReader::TBinding& key, const ICIMClass& cls, const boost::shared_ptr<ICIMNamespace>& ns)
{
    const boost::shared_ptr<ICIMPropertyDecl> decl = FindProperty(cls, key.name);
    if (!decl) {
        return;
    }
    key.name = decl->GetName(TCallContext());
    const TCIMValue::TCIMType type = decl->GetType(TCallContext());
    TCIMValue adapted;
    if (type == TCIMValue::TCIMType::kReference && TValueAccess::IsText(key.value)) {
        key.value = ReadPath(key.value, ns);
    } else if (TValueText::ConvertKey(key.value, type, adapted)) {
        key.value = adapted;
    }
}

}  // namespace

TCIMReference TCIMReference::Parse(const std::string& text, boost::shared_ptr<ICIMNamespace> ns, std::size_t* errorPosition)
{
    TPathReader reader(text);
    try {
        reader.Read();
    } catch (const TZELException&) {
        if (errorPosition != nullptr) {
            *errorPosition = reader.GetPosition();
        }
        throw;
    }
    TCIMReference path(TContents::Make());
    if (!reader.GetHost().empty()) {
        path.SetHost(std::string(reader.GetHost()));
    }
    if (!reader.GetNamespaceName().empty()) {
        path.SetNamespaceName(std::string(reader.GetNamespaceName()));
    }
    const std::string className(reader.GetClassName());
    const boost::shared_ptr<ICIMClass> cls = ns && !className.empty() ? FindClass(*ns, className) : nullptr;
    path.SetClass(cls);
    if (!cls) {
        path.SetClassName(className);
    }
    // The bindings are sorted and have no duplicates, so each is moved to the end instead of being searched for its place.
    TContents& contents = path.Own();
    contents.bindings.Reserve(reader.GetBindings().size());
    for (TPathReader::TBinding& binding : reader.GetBindings()) {
        if (cls) {
            Adapt(binding, *cls, ns);
        }
        TValueAccess::LimitDepth(binding.value, 0);  // text in quotes may hold paths that nest too deeply
        contents.depth = std::max(contents.depth, TContents::GetDepth(binding.value));
        contents.bindings.Append(std::move(binding.name), binding.value);
    }
    return path;
}

}  // namespace NORVZEL20
