// Parses a text as an object path, without a namespace and with the sample's.
//
// The namespace must not decide whether the text is a path. The text of a parsed path must parse to the same path again. Looking
// the path up in the sample must find an instance, find nothing, or fail with a documented status.

#include "embedded/value/TNameText.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"
#include "host/TCIMReference.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// Parses the text. Returns false if it is no path.
bool Parse(const std::string& text, const boost::shared_ptr<ICIMNamespace>& ns, TCIMReference& path)
{
    std::size_t position = std::string::npos;
    try {
        path = TCIMReference::Parse(text, ns, &position);
        return true;
    } catch (const TZELException& error) {
        Promise(error.GetStatusCode().GetStatus() == TZELStatusCode::kParseError,
                "a text that is no path is refused with kParseError (9)");
        Promise(position <= text.size(), "the position of an error lies in the text", std::to_string(position));
        return false;
    }
}

std::string KeyText(const TCIMValue& value)
{
    std::string text;
    value.AppendKeyText(text);
    return text;
}

/// The path's text parses to the same path, with namespace and host in lower case. The text does not hold types: a real without a
/// fraction comes back as an integer.
void CheckRoundTrip(const TCIMReference& path)
{
    const std::string text = path.GetPath();
    TCIMReference again;
    Promise(Parse(text, boost::shared_ptr<ICIMNamespace>(), again), "a path's own text is a path", text);
    PromiseEqual(text, again.GetPath(), "a path's text is a fixed point");
    Promise(TNameText::Equal(path.GetNamespaceName(), again.GetNamespaceName()), "namespaces survive, letter case aside", text);
    Promise(TNameText::Equal(path.GetHost(), again.GetHost()), "hosts survive, letter case aside", text);
    PromiseEqual(path.GetClassName(), again.GetClassName(), "classes survive");
    path.EnumerateKeyBindings([&again](std::pair<std::string, TCIMValue> binding) {
        const TCIMValue* found = again.FindKeyValue(binding.first);
        Promise(found != nullptr && KeyText(*found) == KeyText(binding.second), "bindings survive", binding.first);
        return true;
    });
    Promise(path.GetKeyCount() == again.GetKeyCount(), "no binding is added");
}

/// Looking up any path finds an instance or nothing, or fails with a documented status.
void CheckLookUp(TInMemNamespace& ns, const TCIMReference& path)
{
    try {
        ns.FindInstance(path);
    } catch (const TZELException& error) {
        const int status = error.GetStatusCode().GetStatus();
        Promise(status == TZELStatusCode::kTypeMismatch || status == TZELStatusCode::kKeyMissing,
                "a look-up fails with kTypeMismatch (13) or kKeyMissing (14)", std::to_string(status));
    }
}

}  // namespace

void FuzzPath(std::string_view input)
{
    static const boost::shared_ptr<TInMemNamespace> fgSample = LoadSample();
    const std::string text(input);
    TCIMReference alone;
    TCIMReference placed;
    const bool isPath = Parse(text, boost::shared_ptr<ICIMNamespace>(), alone);
    Promise(Parse(text, fgSample, placed) == isPath, "whether a text is a path does not depend on the namespace");
    if (!isPath) {
        return;
    }
    CheckRoundTrip(alone);
    CheckRoundTrip(placed);
    CheckLookUp(*fgSample, alone);
    CheckLookUp(*fgSample, placed);
}

}  // namespace NORVZEL20
