#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "embedded/cimxml/TLoadReport.h"
#include "embedded/cimxml/TPopulateError.h"
#include "embedded/cimxml/TTextPool.h"

namespace NORVZEL20 {

class TXmlReader;

/// What all parts of one load share: the report, the place in the document, and the one way to fail.
class TCimXmlContext {
  public:
    /// Where something stands in the document.
    struct TPlace {
        std::size_t line = 0;
        std::size_t column = 0;
    };

    /// Says of which place things are told while it lives, instead of the one being read.
    class TAt {
      public:
        TAt(TCimXmlContext& context, const TPlace& place) : fContext(context), fEarlier(context.fPlace) { context.fPlace = place; }
        TAt(const TAt&) = delete;
        TAt& operator=(const TAt&) = delete;
        ~TAt() { fContext.fPlace = fEarlier; }

      private:
        TCimXmlContext& fContext;
        TPlace fEarlier;
    };

    /// `file` is what the document is called in messages.
    explicit TCimXmlContext(std::string file) : fFile(std::move(file)) {}

    /// Names the reader that tells the place; it must outlive the context's use.
    void SetReader(const TXmlReader& reader) noexcept { fReader = &reader; }

    /// Ends the load. Errors: TPopulateError, always.
    [[noreturn]] void Fail(TZELStatusCode::EStatusCode status, const std::string& message) const;

    TPlace GetPlace() const;

    /// Puts up with something: `text` describes the first one of `kind`, the others are counted.
    void Tolerate(const char* kind, const std::string& text);

    /// The document names its namespace, and the host beside it where `host` is not empty. Errors: fails with status 9 for a second
    /// namespace, or host, that is not the first.
    void NoteNamespace(const std::string& name, const std::string& host);

    /// Whether a path to that namespace and host stays within the document's own namespace.
    bool IsOwn(const std::string& name, const std::string& host) const;

    TLoadReport& GetReport() noexcept { return fReport; }
    TTextPool& GetTexts() noexcept { return fTexts; }

    /// Brackets the reading of an embedded object, whose errors say so. Errors: fails with kParseError (9) if objects are nested
    /// too deeply. An error ends the load, so whoever throws need not leave.
    void EnterEmbeddedObject();
    void LeaveEmbeddedObject() noexcept { --fEmbeddedDepth; }

    /// Fails with status 9 where `name` is none that a path can hold: of letters, digits and underscores, or beyond ASCII. `what`
    /// says what it is the name of.
    void CheckName(const char* what, std::string_view name) const;

    /// Does something that the namespace or a value may refuse; that then ends the load, at this place.
    template <class TAct>
    auto Guard(TAct act) const -> decltype(act())
    {
        try {
            return act();
        } catch (const TPopulateError&) {
            throw;
        } catch (const TZELException& error) {
            Fail(error.GetStatusCode().GetStatus(), std::string("found what cannot be taken: ") + error.what());
        }
    }

  private:
    std::string fFile;
    const TXmlReader* fReader = nullptr;
    TPlace fPlace;  // line 0: where the reader is
    TLoadReport fReport;
    std::vector<const char*> fKinds;  // of fReport.tolerated
    TTextPool fTexts;
    std::size_t fEmbeddedDepth = 0;  // embedded objects that are being read, one within the other
};

}  // namespace NORVZEL20
