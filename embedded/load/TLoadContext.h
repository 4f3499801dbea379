#pragma once

#include <cstddef>
#include <exception>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/load/IPlaceSource.h"
#include "embedded/load/TBadValue.h"
#include "embedded/load/TBadValues.h"
#include "embedded/load/TLoadContents.h"
#include "embedded/load/TLoadOptions.h"
#include "embedded/load/TLoadPlace.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/load/TOwnPlaceSearch.h"
#include "embedded/load/TPopulateError.h"
#include "embedded/load/TTextPool.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// What all parts of one load share: the report, the place in the document, the pool of texts, and the one way to fail.
///
/// "Fails" means everywhere in this folder: throws TPopulateError with the status named and with the place that GetPlace returns.
/// Threads: one at a time, as the load that it belongs to.
class CIMDELTA_INTERNAL_EXPORT TLoadContext {
  public:
    /// While it lives, errors and notes are reported at `place` instead of the position being read. It is for parts that were read
    /// earlier and are used only now. Objects may nest; the innermost counts.
    class TAt {
      public:
        TAt(TLoadContext& context, const TLoadPlace& place) : fContext(context), fEarlier(context.fPlace)
        {
            context.fPlace = place;
        }
        TAt(const TAt&) = delete;
        TAt& operator=(const TAt&) = delete;
        ~TAt() { fContext.fPlace = fEarlier; }

      private:
        TLoadContext& fContext;
        std::optional<TLoadPlace> fEarlier;
    };

    /// Stands around the reading of an embedded object; messages then mention that they are about one. If an exception ends it, the
    /// object is discarded, so the values within it that do not fit are not counted.
    class TEmbedded {
      public:
        /// Errors: fails with kParseError (9) if objects are nested too deeply.
        explicit TEmbedded(TLoadContext& context)
            : fContext(context), fMark(context.fBadValues.GetMark()), fExceptions(std::uncaught_exceptions())
        {
            context.EnterEmbeddedObject();
        }
        TEmbedded(const TEmbedded&) = delete;
        TEmbedded& operator=(const TEmbedded&) = delete;
        ~TEmbedded()
        {
            --fContext.fEmbeddedDepth;
            if (std::uncaught_exceptions() > fExceptions) {
                fContext.fBadValues.TakeBack(fMark);
            }
        }

      private:
        TLoadContext& fContext;
        std::size_t fMark;
        int fExceptions;
    };

    /// `embeddedDepth` is how many embedded objects what is read stands in.
    explicit TLoadContext(std::size_t embeddedDepth = 0) noexcept : fEmbeddedDepth(embeddedDepth) {}
    /// For what stands in no embedded object.
    explicit TLoadContext(TLoadOptions options);
    TLoadContext(const TLoadContext&) = delete;
    TLoadContext& operator=(const TLoadContext&) = delete;
    ~TLoadContext();

    /// Begins a document, perhaps within another one. `name` is what messages call it, and `reader` knows the place in it, until
    /// EndDocument.
    void BeginDocument(std::string name, const IPlaceSource& reader);
    /// Goes on with a document that has ended, until EndDocument. `number` is that of the document.
    void ResumeDocument(std::size_t number, const IPlaceSource& reader) { fOpen.push_back({number, &reader}); }
    /// Ends the document that was begun last. What fails after it, outside of any document and TAt, is reported at its end.
    void EndDocument();

    /// Ends the load. `message` says what was found and what was expected or can be done. If values that do not fit were found
    /// before and are to be refused, the error is about the first of them instead.
    [[noreturn]] void Fail(TZELStatusCode::EStatusCode status, const std::string& message, EAdvice advice = EAdvice::kNone) const;

    /// What follows the name of a class that is needed but not declared.
    const char* DescribeUndeclared() const noexcept;

    /// Counts a value of a property of `className` that does not fit its type. `isInInstance`: see TBadValues::Note.
    void NoteBadValue(const TBadValue& bad, const std::string& className, const std::string& property, bool isInInstance);
    /// Fails with kTypeMismatch (13), since a key cannot be NULL.
    [[noreturn]] void FailBadKey(const TBadValue& bad, const std::string& className, const std::string& property) const;
    TBadValues& GetBadValues() noexcept { return fBadValues; }
    /// Call it when everything was read. Errors: fails with kTypeMismatch (13) if there are values to be refused.
    void RefuseBadValues() const;

    /// The place of the innermost TAt, or else the position being read.
    TLoadPlace GetPlace() const;
    /// The same as text: `file:line:column`.
    std::string Describe(const TLoadPlace& place) const;
    std::size_t CountDocuments() const noexcept { return fDocuments.size(); }
    /// What messages call the document of that number.
    const std::string& GetDocument(std::size_t number) const { return fDocuments[number]; }

    /// Notes in the report something odd that does not end the load. `kind` must be a string literal: the first call with it adds
    /// `text` and its place to the report, later ones are counted.
    void Tolerate(const char* kind, const std::string& text);

    /// Notes the namespace that the document names for itself, with its host (may be empty). The first of each goes to the report.
    /// Errors: fails with kParseError (9) for a namespace or a host that is not the first one.
    void NoteNamespace(const std::string& name, const std::string& host);

    const TLoadOptions& GetOptions() const noexcept { return fOptions; }
    TLoadReport& GetReport() noexcept { return fReport; }
    /// Decides which references stay within the document's own namespace.
    TOwnPlaceSearch& GetOwnPlace() noexcept { return fOwnPlace; }
    TTextPool& GetTexts() noexcept { return fTexts; }
    TLoadContents& GetContents() noexcept { return fContents; }
    /// Call it when all documents have been read. Errors: fails with kParseError (9) if they hold nothing that can be loaded, or an
    /// answer whose continuation is missing; see TLoadContents.
    void CheckContents();

    /// Whether an embedded object that cannot be read is a bad value, as TLoadOptions::badValues says, and not the end of the load.
    bool LetsPass(const TPopulateError& error) const noexcept;
    /// Throws the error about the text of an embedded object again, with what can be done instead of correcting it.
    [[noreturn]] static void RefuseObject(const TPopulateError& error);
    std::size_t GetEmbeddedDepth() const noexcept { return fEmbeddedDepth; }

    /// Checks a name that may become part of a path. `what` says what it names: "class", "property" or "key". Errors: fails with
    /// kParseError (9) if it has characters other than ASCII letters, digits, underscores and what is beyond ASCII.
    void CheckName(const char* what, std::string_view name) const;

    /// Returns what `act` returns. If it throws a TZELException, because the namespace or a value refuses something, fails with
    /// that status and adds the place; a TPopulateError passes as it is.
    template <class TAct>
    auto Guard(TAct act) const -> decltype(act())
    {
        try {
            return act();
        } catch (const TPopulateError&) {
            throw;
        } catch (const TZELException& error) {
            Fail(error.GetStatusCode().GetStatus(), std::string("found something that cannot be loaded: ") + error.what());
        }
    }

  private:
    void EnterEmbeddedObject();
    std::string NameOf(const TLoadPlace& place) const;

    struct TOpen {
        std::size_t number;  // of the document
        const IPlaceSource* reader;
    };

    bool HasRefused() const noexcept { return fOptions.badValues == EBadValues::kRefuse && fBadValues.HasAny(); }
    [[noreturn]] void FailSecond(const std::string& what, const std::string& name, const std::string& first,
                                 const TLoadPlace& firstPlace) const;
    [[noreturn]] void FailForBadValues(bool isWhole) const;
    [[noreturn]] void Throw(TZELStatusCode::EStatusCode status, const std::string& message, const TLoadPlace& place,
                            EAdvice advice) const;

    std::vector<std::string> fDocuments;        // their names
    std::vector<TOpen> fOpen;                   // the innermost document comes last
    TLoadPlace fEnd;                            // of the document that was ended last
    std::optional<TLoadPlace> fPlace;           // of the innermost TAt
    std::optional<TLoadPlace> fNamespacePlace;  // where the documents first name their namespace
    TLoadPlace fHostPlace;                      // likewise their host
    TLoadReport fReport;
    TOwnPlaceSearch fOwnPlace{fReport};
    TBadValues fBadValues{fReport.badProperties};
    std::vector<const char*> fKinds;  // of the entries of fReport.tolerated
    TTextPool fTexts;
    TLoadOptions fOptions;
    TLoadContents fContents;
    std::size_t fEmbeddedDepth = 0;  // embedded objects that are being read, one inside of the other
};

}  // namespace NORVZEL20
