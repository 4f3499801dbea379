// From what MOF documents declare to a load:
//
//     bytes --DecodeMof--> text --TMofLexer--> tokens --TMofParser--> TMofReader --> TLoader of the session
//
// Qualifiers and classes go to the loader at once. An instance says no types and may refer to later ones by their aliases, so
// instances wait until the classes of all documents are declared. So do classes with a qualifier that is not declared yet, until
// all documents have been read.
//
// An included document is read where the pragma stands. A file is read once in a session, however often it is included; a file that
// includes itself, perhaps through others, is an error. A document knows the aliases of all files that it includes, also of those
// that were read for an earlier document.
#include "embedded/mof/TMofReader.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <string_view>
#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoader.h"
#include "embedded/mof/DecodeMof.h"
#include "embedded/mof/TMofInstanceMaker.h"
#include "embedded/mof/TMofLimits.h"
#include "embedded/mof/TMofParser.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/Trim.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

/// Whether the bytes begin as those of gzip, xz, zstd or bzip2 do. No MOF begins so.
bool AreCompressed(const std::string& bytes)
{
    constexpr std::string_view kBeginnings[] = {"\x1f\x8b", "\xfd\x37zXZ", "\x28\xb5\x2f\xfd", "BZh"};
    return std::any_of(std::begin(kBeginnings), std::end(kBeginnings),
                       [&](std::string_view beginning) { return bytes.compare(0, beginning.size(), beginning) == 0; });
}

}  // namespace

TMofReader::TMofReader(TLoadSession& session, boost::shared_ptr<IMofIncludes> includes)
    : fSession(session), fContext(session.GetContext()), fIncludes(std::move(includes))
{}

void TMofReader::Read(std::string bytes, const std::string& name)
{
    fUnits.emplace_back();
    fNamespaceName.clear();
    fHost.clear();
    fOpenFiles.clear();
    const std::string identity = Identify(name);
    if (!identity.empty()) {
        if (!NoteFile(identity)) {
            return;
        }
        fOpenFiles.push_back(identity);
    }
    ReadDocument(std::move(bytes), name);
    if (!identity.empty()) {
        fFiles.find(identity)->second.end = fUnits.back().instances.size();
    }
}

/// The identity of a document that others could include; empty for others.
std::string TMofReader::Identify(const std::string& name) const
{
    IMofIncludes::TFile file;
    std::string reason;
    return fIncludes && fIncludes->Find(name.substr(name.rfind('/') + 1), name, file, reason) ? file.identity : std::string();
}

/// Notes that the file is being read for the last unit; false if it was read before.
bool TMofReader::NoteFile(const std::string& identity)
{
    const std::size_t begin = fUnits.back().instances.size();
    return fFiles.emplace(identity, TFile{fUnits.size() - 1, begin, begin, {}}).second;
}

void TMofReader::ReadDocument(std::string bytes, const std::string& name)
{
    const bool isEmpty = bytes.empty() && fOpenNames.empty();
    std::string problem;
    const std::string text = DecodeMof(std::move(bytes), problem);
    problem = isEmpty ? "found an empty document, expected MOF" : problem;
    TMofTokens tokens(fContext, text);
    fContext.BeginDocument(name, tokens.GetReader());
    if (!problem.empty()) {
        fContext.Fail(EStatus::kParseError, problem);
    }
    fOpenNames.push_back(name);
    TMofParser(tokens, text, *this).Parse();
    fOpenNames.pop_back();
    fContext.EndDocument();
}

boost::shared_ptr<TInMemQualifierDecl> TMofReader::FindQualifierDecl(const std::string& name)
{
    return fSession.GetNamespace()->FindQualifierDecl(name);
}

void TMofReader::OnQualifierDecl(const TQualifierDraft& draft)
{
    fSession.GetLoader().AddQualifierDecl(draft);
}

void TMofReader::OnClass(TDraft draft)
{
    fSession.GetLoader().AddClass(std::move(draft));
}

bool TMofReader::OnUndeclared(TMofPart part)
{
    if (!fIsLast) {
        fParts.push_back(std::move(part));
    }
    return fIsLast;
}

void TMofReader::OnInstance(TMofInstance instance)
{
    NoteNamespace();
    if (fContext.GetOptions().takesDeclarationsOnly) {
        return fContext.GetContents().NoteObject();
    }
    fUnits.back().instances.push_back(std::move(instance));
}

void TMofReader::OnPragma(const std::string& name, const std::string& text)
{
    if (TNameText::Equal(name, "include")) {
        Include(text);
    } else if (TNameText::Equal(name, "namespace")) {
        SetNamespace(text);
    }
}

void TMofReader::Include(const std::string& name)
{
    const std::string found = "found an include of " + Quote(name) + ", ";
    if (!fIncludes) {
        fContext.Fail(EStatus::kParseError, found + "but no folders are given for included files; give the folder that it is in");
    }
    IMofIncludes::TFile file;
    std::string reason;
    if (!fIncludes->Find(name, fOpenNames.back(), file, reason)) {
        fContext.Fail(EStatus::kParseError, found + reason, EAdvice::kPlaceIncludedFile);
    }
    if (std::find(fOpenFiles.begin(), fOpenFiles.end(), file.identity) != fOpenFiles.end()) {
        fContext.Fail(EStatus::kParseError, found + "which includes this document; remove one of the two");
    }
    if (!fOpenFiles.empty()) {
        fFiles.find(fOpenFiles.back())->second.includes.push_back(file.identity);
    }
    if (!NoteFile(file.identity)) {
        fUnits.back().repeated.push_back(file.identity);
        return;
    }
    if (fOpenNames.size() > TMofLimits::kMaxIncludeDepth + 1 || fFiles.size() > TMofLimits::kMaxIncluded) {
        fContext.Fail(EStatus::kParseError, found + "which is one too many or too deep; join some of the files");
    }
    std::string bytes;
    if (!fIncludes->Read(file, TMofLimits::kMaxBytes, bytes, reason)) {
        fContext.Fail(EStatus::kFileError, found + reason);
    }
    if (AreCompressed(bytes)) {
        fContext.Fail(EStatus::kParseError, found + "which is compressed; included files must be plain, so decompress it");
    }
    fOpenFiles.push_back(file.identity);
    ReadDocument(std::move(bytes), file.name);
    fOpenFiles.pop_back();
    fFiles.find(file.identity)->second.end = fUnits.back().instances.size();
}

/// Forms in use: root/cimv2, /root/cimv2, //host/root/cimv2, http://host/root/cimv2, and the same with backslashes. The host "."
/// is this one.
void TMofReader::SetNamespace(std::string text)
{
    std::replace(text.begin(), text.end(), '\\', '/');
    fNamespacePlace = fContext.GetPlace();
    fHost.clear();
    const std::size_t slashes = text.find("//");
    if (slashes != std::string::npos) {
        const std::size_t end = std::min(text.find('/', slashes + 2), text.size());
        fHost = text.substr(slashes + 2, end - slashes - 2);
        fHost = fHost == "." ? "" : fHost;
        text.erase(0, end);
    }
    fNamespaceName = std::string(Trim(text, "/"));
    if (fNamespaceName.find_first_of(":=\"") != std::string::npos) {
        fContext.Fail(EStatus::kParseError,
                      "found namespace " + Quote(fNamespaceName) + ", expected a name without colons, equals signs and quotes");
    }
}

/// A namespace matters to instances only: the classes of a schema go where they are needed.
void TMofReader::NoteNamespace()
{
    if (!fNamespaceName.empty()) {
        const TLoadContext::TAt at(fContext, fNamespacePlace);
        fContext.NoteNamespace(fNamespaceName, fHost);
    }
}

void TMofReader::AddClasses()
{
    fIsLast = true;
    for (const TMofPart& part : std::exchange(fParts, {})) {
        TMofTokens tokens(fContext, part.text, part.place.place);
        fContext.ResumeDocument(part.place.document, tokens.GetReader());
        TMofParser(tokens, part.text, *this).Parse();
        fContext.EndDocument();
    }
}

/// The instances that aliases of the unit can name: its own, and those of files that were read for earlier ones.
std::vector<const TMofInstance*> TMofReader::FindAliased(std::size_t unit) const
{
    std::vector<const TMofInstance*> aliased;
    const auto add = [&](std::size_t from, std::size_t begin, std::size_t end) {
        for (; begin < end; ++begin) {
            const TMofInstance& instance = fUnits[from].instances[begin];
            if (!instance.alias.empty()) {
                aliased.push_back(&instance);
            }
        }
    };
    add(unit, 0, fUnits[unit].instances.size());
    std::vector<std::string> files = fUnits[unit].repeated;
    for (std::set<std::string> seen; !files.empty();) {
        const std::string identity = std::move(files.back());
        files.pop_back();
        if (!seen.insert(identity).second) {
            continue;
        }
        const TFile& file = fFiles.find(identity)->second;
        files.insert(files.end(), file.includes.begin(), file.includes.end());
        if (file.unit != unit) {
            add(file.unit, file.begin, file.end);
        }
    }
    return aliased;
}

/// An instance is forgotten when it is added. One with an alias is kept, because others may refer to it.
void TMofReader::AddInstances(const TLoader::TReadObjects& readObjects)
{
    for (std::size_t unit = 0; unit < fUnits.size(); ++unit) {
        for (const TMofInstance& instance : fUnits[unit].instances) {
            fSession.GetLoader().FindClass(instance.className);  // perhaps the load's schema has it
        }
        TMofInstanceMaker maker(fContext, *fSession.GetNamespace(), *this, FindAliased(unit));
        for (TMofInstance& instance : fUnits[unit].instances) {
            fSession.GetLoader().FillInstance(maker.Make(instance), readObjects);
            if (instance.alias.empty()) {
                instance = TMofInstance();
            }
        }
    }
    fUnits.clear();
}

}  // namespace NORVZEL20
