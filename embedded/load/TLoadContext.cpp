// One document, one namespace.
//
// A document may name its namespace several times: in each group, and in the name in front of each object. The first name counts,
// and any other is an error, because objects of two namespaces would fall together in one. The same holds for the host. What
// a document does not name is the business of TOwnPlaceSearch.
#include "embedded/load/TLoadContext.h"

#include <algorithm>
#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TUtf8.h"
#include "embedded/value/Trim.h"

namespace NORVZEL20 {

TLoadContext::TLoadContext(TLoadOptions options) : fOptions(std::move(options))
{
    const std::string_view name = Trim(fOptions.namespaceName, "/");
    if (!name.empty()) {
        fReport.namespaceName = name;
        fReport.namespaceOrigin = TLoadReport::kFromOptions;
    }
}

TLoadContext::~TLoadContext() = default;

void TLoadContext::BeginDocument(std::string name, const IPlaceSource& reader)
{
    fDocuments.push_back(std::move(name));
    ResumeDocument(fDocuments.size() - 1, reader);
}

void TLoadContext::EndDocument()
{
    fEnd = GetPlace();
    fOpen.pop_back();
}

void TLoadContext::Fail(TZELStatusCode::EStatusCode status, const std::string& message, EAdvice advice) const
{
    if (HasRefused()) {
        FailForBadValues(false);
    }
    Throw(status, fEmbeddedDepth > 0 ? "in an embedded object: " + message : message, GetPlace(), advice);
}

std::string TLoadContext::Describe(const TLoadPlace& place) const
{
    return NameOf(place) + ":" + std::to_string(place.place.line) + ":" + std::to_string(place.place.column);
}

/// Empty before the first document.
std::string TLoadContext::NameOf(const TLoadPlace& place) const
{
    return place.document < fDocuments.size() ? fDocuments[place.document] : std::string();
}

void TLoadContext::Throw(TZELStatusCode::EStatusCode status, const std::string& message, const TLoadPlace& place,
                         EAdvice advice) const
{
    throw TPopulateError(status, message, NameOf(place), place.place.line, place.place.column, advice);
}

const char* TLoadContext::DescribeUndeclared() const noexcept
{
    return fOptions.schema ? ", which neither the documents nor the schema declare; give its declaration"
                           : ", which is not declared; give its declaration";
}

void TLoadContext::NoteBadValue(const TBadValue& bad, const std::string& className, const std::string& property, bool isInInstance)
{
    constexpr std::size_t kLongestText = 80;
    TBadProperty first;
    first.className = className;
    first.property = property;
    first.text = TUtf8::Shorten(bad.text, kLongestText);
    first.text += first.text.size() < bad.text.size() ? "..." : "";
    first.type = bad.type;
    first.isKeptAsText = isInInstance && fOptions.badValues == EBadValues::kText;
    first.document = NameOf(bad.place);
    first.line = bad.place.place.line;
    first.column = bad.place.place.column;
    fBadValues.Note(std::move(first), isInInstance, fEmbeddedDepth > 0);
}

void TLoadContext::FailBadKey(const TBadValue& bad, const std::string& className, const std::string& property) const
{
    Throw(TZELStatusCode::kTypeMismatch,
          "found " + Quote(bad.text) + " in key " + Quote(property) + " of class " + Quote(className) + ", expected a " + bad.type +
              "; a key cannot be NULL, so correct it, or have such values loaded as text",
          bad.place, EAdvice::kKeepBadValuesAsText);
}

void TLoadContext::RefuseBadValues() const
{
    if (HasRefused()) {
        FailForBadValues(true);
    }
}

void TLoadContext::FailForBadValues(bool isWhole) const
{
    const TBadProperty& first = fReport.badProperties.front();
    throw TPopulateError(TZELStatusCode::kTypeMismatch, fBadValues.Describe(isWhole), first.document, first.line, first.column,
                         fBadValues.HasKey() ? EAdvice::kKeepBadValuesAsText : EAdvice::kLetBadValuesPass);
}

void TLoadContext::EnterEmbeddedObject()
{
    constexpr std::size_t kMaxDepth = 32;
    if (fEmbeddedDepth == kMaxDepth) {
        Fail(TZELStatusCode::kParseError, "embedded objects are nested too deeply");
    }
    ++fEmbeddedDepth;
}

bool TLoadContext::LetsPass(const TPopulateError& error) const noexcept
{
    return fOptions.badValues != EBadValues::kRefuse && error.GetStatusCode().GetStatus() != TZELStatusCode::kOutOfMemory;
}

void TLoadContext::RefuseObject(const TPopulateError& error)
{
    if (error.GetAdvice() != EAdvice::kNone || error.GetStatusCode().GetStatus() == TZELStatusCode::kOutOfMemory) {
        throw error;
    }
    throw TPopulateError(error.GetStatusCode(), error.GetMessage() + "; correct it, or have such values loaded as NULL or as text",
                         error.GetFile(), error.GetLine(), error.GetColumn(), EAdvice::kLetBadValuesPass);
}

TLoadPlace TLoadContext::GetPlace() const
{
    if (fPlace) {
        return *fPlace;
    }
    return fOpen.empty() ? fEnd : TLoadPlace{fOpen.back().number, fOpen.back().reader->GetPlace()};
}

void TLoadContext::Tolerate(const char* kind, const std::string& text)
{
    // Kinds are string literals, one for each caller, so comparing pointers is enough.
    const auto known = std::find(fKinds.begin(), fKinds.end(), kind);
    if (known != fKinds.end()) {
        TLoadReport::TTolerated& first = fReport.tolerated[static_cast<std::size_t>(known - fKinds.begin())];
        ++first.count;
        first.others += text != first.text ? 1 : 0;
        return;
    }
    fKinds.push_back(kind);
    const TLoadPlace place = GetPlace();
    fReport.tolerated.push_back({text, NameOf(place), place.place.line, 1, 0});
}

void TLoadContext::NoteNamespace(const std::string& name, const std::string& host)
{
    if (!fReport.namesNamespace) {
        fReport.namesNamespace = true;
        fReport.namespaceOrigin = TLoadReport::kFromDocuments;
        fReport.namespaceName = name;
    }
    fNamespacePlace = fNamespacePlace ? fNamespacePlace : GetPlace();
    if (!TNameText::Equal(name, fReport.namespaceName)) {
        FailSecond("namespace", name, fReport.namespaceName, *fNamespacePlace);
    }
    if (host.empty()) {
        return;
    }
    if (fReport.host.empty()) {
        fReport.host = host;
        fHostPlace = GetPlace();
    }
    if (!TNameText::Equal(host, fReport.host)) {
        FailSecond("host", host, fReport.host, fHostPlace);
    }
}

void TLoadContext::FailSecond(const std::string& what, const std::string& name, const std::string& first,
                              const TLoadPlace& firstPlace) const
{
    const std::string found = "found " + what + " " + Quote(name);
    if (GetPlace().document == firstPlace.document) {
        Fail(TZELStatusCode::kParseError,
             found + " after " + Quote(first) + "; a document holds one " + what + ", so split this one");
    }
    Fail(TZELStatusCode::kParseError, found + ", but " + Quote(first) + " at " + Describe(firstPlace) +
                                          "; an inventory holds one " + what + ", so load the two documents as two inventories");
}

void TLoadContext::CheckContents()
{
    if (const std::optional<TLoadContents::TFault> fault = fContents.FindFault()) {
        const TAt at(*this, fault->place);
        Fail(TZELStatusCode::kParseError, fault->message);
    }
}

/// Other characters, such as a dot, a comma or a colon, could make two different paths read the same.
void TLoadContext::CheckName(const char* what, std::string_view name) const
{
    if (!std::all_of(name.begin(), name.end(), TNameText::IsNamePart)) {
        Fail(TZELStatusCode::kParseError,
             std::string("found ") + what + " " + Quote(name) + ", expected a name of letters, digits and underscores");
    }
}

}  // namespace NORVZEL20
