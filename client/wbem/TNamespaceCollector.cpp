// The instances of a class come together with those of the classes below it. So the classes without a superclass are asked for:
//
//     CIM_ManagedElement                           CIM_FAILED by its provider: go down one level
//       CIM_Disk         all of its instances
//       CIM_Fan          CIM_FAILED again: not collected
//
// If the server fails for one of them, or gives an answer that does not load, each class directly below it is asked for instead,
// and so on. One bad provider costs its own classes that way, and not those beside them. What only the class itself has, not one
// below it, cannot be asked for; it is not collected.
//
// Each tree is loaded by itself, to see whether it loads, and dropped again. At the end all answers are loaded together.
#include "client/wbem/TNamespaceCollector.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <utility>

#include "client/process/LackOfMemory.h"
#include "client/text/DisplayText.h"
#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadOptions.h"
#include "embedded/load/TPopulateError.h"

namespace NORVZEL20 {

namespace {

const char kNotSupportedStatus[] = "7";
const char kInvalidNamespace[] = "3";
const std::size_t kMostEmptyAnswers = 1000;

TLoadOptions OptionsFor(const std::string& namespaceName)
{
    TLoadOptions options;
    options.namespaceName = namespaceName;
    return options;
}

// Loads what `read` reads into the session. Errors: TWbemFault.
template <class TRead>
TLoadReport LoadAnswers(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& server, const TLoadOptions& options,
                        TRead read)
{
    try {
        TLoadSession session(ns, server, options);
        read(session);
        return session.Commit();
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TWbemFault(TWbemFault::kAnswer, server, error.what());
    }
}

// A message says what was found, then behind a semicolon what can be done where files are loaded.
std::string WithoutAdvice(const std::string& message)
{
    const std::size_t quoted = message.rfind('"');
    return message.substr(0, message.find("; ", quoted == std::string::npos ? 0 : quoted));
}

// The class and those below it.
std::size_t CountTree(TInMemClass& cls)
{
    std::size_t count = 1;
    const auto add = [&count](const boost::shared_ptr<ICIMClass>&) {
        ++count;
        return true;
    };
    cls.EnumerateSubClasses(add, true, TCallContext());
    return count;
}

void ReadText(TLoadSession& session, const std::string& text)
{
    TCimXmlDocuments(session).ReadMemory(text.data(), text.size(), "what was not collected");
}

}  // namespace

TNamespaceCollector::TNamespaceCollector(TWbemServer& server, std::string namespaceName)
    : fServer(server), fNamespaceName(std::move(namespaceName))
{}

TNamespaceCollector::TResult TNamespaceCollector::Collect()
{
    ReadDeclarations();
    for (const boost::shared_ptr<TInMemClass>& cls : fSchema->GetClasses()) {
        if (!cls->GetSuperInMemClass()) {
            ReadTree(*cls);
        }
    }
    RequireSomething();
    return Load();
}

void TNamespaceCollector::ReadDeclarations()
{
    fServer.Ask(EnumerateClasses(fNamespaceName), &fAnswers);
    try {
        fServer.Ask(EnumerateQualifiers(fNamespaceName), &fAnswers);
    } catch (const TWbemFault& fault) {
        // Classes bring their qualifiers along; without declarations, flavors are the defaults.
        if (!fault.IsOfThisRequest()) {
            throw;
        }
    }
    fSchema = TInMemNamespace::Create(fNamespaceName);
    TLoadOptions options = OptionsFor(fNamespaceName);
    options.takesDeclarationsOnly = true;
    LoadAnswers(fSchema, fServer.GetAddress().server, options, [this](TLoadSession& session) { fAnswers.Load(0, session); });
    fServer.GetCounts().classes = fSchema->GetClasses().size();
    fServer.GetCounts().finished = 0;
}

void TNamespaceCollector::ReadTree(TInMemClass& root)
{
    std::vector<boost::shared_ptr<TInMemClass>> pending;  // the last one is next
    for (TInMemClass* next = &root; next != nullptr;) {
        std::string reason;
        if (TryTree(*next, reason)) {
            ++fTreesRead;
            fServer.GetCounts().finished += CountTree(*next);
        } else {
            ++fServer.GetCounts().finished;
            const std::vector<boost::shared_ptr<TInMemClass>> below = next->GetSubClasses();
            if (below.empty() || !next->IsAbstract(TCallContext())) {
                LeaveOut(next->GetName() + (below.empty() ? "" : " itself"), reason);
            }
            pending.insert(pending.end(), below.rbegin(), below.rend());
        }
        next = nullptr;
        if (!pending.empty()) {
            next = &*pending.back();
            pending.pop_back();
        }
    }
}

// Returns whether all instances of the class and of those below it were read; otherwise nothing of them is kept.
bool TNamespaceCollector::TryTree(const TInMemClass& cls, std::string& reason)
{
    const std::size_t before = fAnswers.CountAnswers();
    try {
        // Answers without an instance load with others only.
        if (ReadInstances(cls.GetName()) > 0) {
            CheckInstances(before);
        }
        return true;
    } catch (const TWbemFault& fault) {
        if (!fault.IsOfThisRequest() || fault.GetStatus() == kInvalidNamespace) {
            throw;
        }
        reason = fault.GetReason();
    } catch (const TPopulateError& error) {
        reason = WithoutAdvice(error.GetMessage());
    }
    fAnswers.KeepFirst(before);
    return false;
}

// Returns how many there were.
std::size_t TNamespaceCollector::ReadInstances(const std::string& className)
{
    if (fOffersPull) {
        if (const std::optional<std::size_t> count = ReadByPull(className)) {
            return *count;
        }
    }
    return fServer.Ask(EnumerateInstances(fNamespaceName, className), &fAnswers).instances;
}

// Returns how many there were; nothing if the server does not offer that, and nothing was read then.
std::optional<std::size_t> TNamespaceCollector::ReadByPull(const std::string& className)
{
    const std::size_t before = fAnswers.CountAnswers();
    for (unsigned int tries = 1;; ++tries) {
        bool isLost = false;
        try {
            return Pull(className, isLost);
        } catch (const TWbemFault& fault) {
            fAnswers.KeepFirst(before);
            if (fault.GetStatus() == kNotSupportedStatus) {
                fOffersPull = false;
                return std::nullopt;
            }
            // An answer that was lost cannot be had again, since the enumeration has moved on: it begins anew.
            if (!isLost || tries >= fServer.GetLimits().tries) {
                throw;
            }
        }
        fServer.Pause(tries);
    }
}

// `isLost` says whether an answer may have been lost on its way.
std::size_t TNamespaceCollector::Pull(const std::string& className, bool& isLost)
{
    const std::size_t most = fServer.GetLimits().objectsAtOnce;
    TWbemAnswer answer = fServer.Ask(OpenEnumerateInstances(fNamespaceName, className, most), &fAnswers);
    std::size_t count = answer.instances;
    std::size_t empty = 0;
    while (!answer.isEndOfSequence) {
        empty = answer.instances == 0 ? empty + 1 : 0;
        if (answer.context.empty() || empty > kMostEmptyAnswers) {
            Close(className, answer.context);
            throw TWbemFault(TWbemFault::kAnswer, fServer.GetAddress().server,
                             answer.context.empty() ? "found no EnumerationContext, expected one or the end of the sequence"
                                                    : "found " + std::to_string(empty) + " answers without instances in a row");
        }
        try {
            answer = fServer.Ask(PullInstancesWithPath(fNamespaceName, className, answer.context, most), &fAnswers);
            count += answer.instances;
        } catch (const TWbemFault& fault) {
            isLost = fault.MayPass();
            if (fault.GetKind() == TWbemFault::kStatus || fault.GetKind() == TWbemFault::kAnswer) {
                Close(className, answer.context);
            }
            throw;
        }
    }
    return count;
}

// Lets the server forget an enumeration that is not read to its end. It forgets it by itself too, only later.
void TNamespaceCollector::Close(const std::string& className, const std::string& context)
{
    if (context.empty()) {
        return;
    }
    try {
        fServer.Ask(CloseEnumeration(fNamespaceName, className, context));
    } catch (const TWbemFault&) {
        // The failure that led here is the one to report.
    }
}

// Errors: TPopulateError if the answers from that one on do not load.
void TNamespaceCollector::CheckInstances(std::size_t first) const
{
    TLoadOptions options = OptionsFor(fNamespaceName);
    options.schema = fSchema;
    TLoadSession session(TInMemNamespace::Create(fNamespaceName), fNamespaceName, options);
    ReadText(session, WriteNotCollected(fNamespaceName, {}, false));
    fAnswers.Load(first, session);
    session.Commit();
}

void TNamespaceCollector::LeaveOut(const std::string& subject, const std::string& reason)
{
    const auto same = std::find_if(fNotCollected.begin(), fNotCollected.end(),
                                   [&](const TNotCollected& entry) { return entry.reason == reason; });
    if (same == fNotCollected.end()) {
        fNotCollected.push_back({"instances", reason, {subject}, 1});
        return;
    }
    same->subjects.push_back(subject);
    ++same->count;
}

// An inventory of nothing would look like a system without instances.
void TNamespaceCollector::RequireSomething() const
{
    if (fTreesRead == 0 && !fNotCollected.empty()) {
        throw TWbemFault(TWbemFault::kAnswer, fServer.GetAddress().server,
                         "nothing could be collected from " + EscapeForDisplay(fNamespaceName) + "; " +
                             EscapeForDisplay(fNotCollected[0].subjects[0]) + ": " + fNotCollected[0].reason);
    }
}

TNamespaceCollector::TResult TNamespaceCollector::Load()
{
    TResult result;
    result.ns = TInMemNamespace::Create(fNamespaceName);
    result.notCollected = fNotCollected;
    const bool declares = !fSchema->FindClass(kNotCollectedClass);
    result.loaded = LoadAnswers(result.ns, fServer.GetAddress().server, OptionsFor(fNamespaceName), [&](TLoadSession& session) {
        fAnswers.Load(0, session);
        ReadText(session, WriteNotCollected(fNamespaceName, fNotCollected, declares));  // names the namespace too
    });
    return result;
}

}  // namespace NORVZEL20
