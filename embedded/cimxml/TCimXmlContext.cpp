// One document, one namespace.
//
// A document may name its namespace several times: in each group, and in the name in front of each object. The first name counts,
// and any other is an error, because objects of two namespaces would fall together in one. The same holds for the host. What
// a document does not name is the business of TCimXmlOwnPlace.
#include "embedded/cimxml/TCimXmlContext.h"

#include <algorithm>
#include <utility>

#include "embedded/cimxml/MessageText.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

TCimXmlContext::TCimXmlContext(std::string file, std::size_t embeddedDepth) : fFile(std::move(file)), fEmbeddedDepth(embeddedDepth)
{}

TCimXmlContext::~TCimXmlContext() = default;

void TCimXmlContext::Fail(TZELStatusCode::EStatusCode status, const std::string& message) const
{
    const TXmlPlace place = GetPlace();
    throw TPopulateError(status, fEmbeddedDepth > 0 ? "in an embedded object: " + message : message, fFile, place.line,
                         place.column);
}

void TCimXmlContext::EnterEmbeddedObject()
{
    constexpr std::size_t kMaxDepth = 32;
    if (fEmbeddedDepth == kMaxDepth) {
        Fail(TZELStatusCode::kParseError, "embedded objects are nested too deeply");
    }
    ++fEmbeddedDepth;
}

TXmlPlace TCimXmlContext::GetPlace() const
{
    return fPlace ? *fPlace : fReader->GetPlace();
}

void TCimXmlContext::Tolerate(const char* kind, const std::string& text)
{
    // Kinds are string literals, one for each caller, so comparing pointers is enough.
    const auto known = std::find(fKinds.begin(), fKinds.end(), kind);
    if (known != fKinds.end()) {
        ++fReport.tolerated[static_cast<std::size_t>(known - fKinds.begin())].count;
        return;
    }
    fKinds.push_back(kind);
    fReport.tolerated.push_back({text, GetPlace().line, 1});
}

void TCimXmlContext::NoteNamespace(const std::string& name, const std::string& host)
{
    if (!fReport.namesNamespace) {
        fReport.namesNamespace = true;
        fReport.namespaceName = name;
    }
    if (!TNameText::Equal(name, fReport.namespaceName)) {
        Fail(TZELStatusCode::kParseError, "found namespace " + Quote(name) + " after " + Quote(fReport.namespaceName) +
                                              "; a document holds one namespace, so split this one");
    }
    if (fReport.host.empty()) {
        fReport.host = host;
    }
    if (!host.empty() && !TNameText::Equal(host, fReport.host)) {
        Fail(TZELStatusCode::kParseError,
             "found host " + Quote(host) + " after " + Quote(fReport.host) + "; a document comes from one host, so split this one");
    }
}

/// Other characters, such as a dot, a comma or a colon, could make two different paths read the same.
void TCimXmlContext::CheckName(const char* what, std::string_view name) const
{
    if (!std::all_of(name.begin(), name.end(), TNameText::IsNamePart)) {
        Fail(TZELStatusCode::kParseError,
             std::string("found ") + what + " " + Quote(name) + ", expected a name of letters, digits and underscores");
    }
}

}  // namespace NORVZEL20
