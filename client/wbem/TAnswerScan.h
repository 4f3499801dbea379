#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

#include "client/wbem/TWbemAnswer.h"
#include "embedded/cimxml/IXmlSink.h"
#include "embedded/cimxml/TXmlReader.h"

namespace NORVZEL20 {

/// Reads the message of an answer (DSP0201) while it arrives: errors, the parameters of an enumeration, how many instances. What
/// the instances hold is for the loader.
class TAnswerScan : private IXmlSink {
  public:
    /// `onInstance` is called for each instance, and may throw. Errors: std::bad_alloc.
    explicit TAnswerScan(std::function<void()> onInstance = {});

    /// Takes the next piece. Errors: what `onInstance` throws; std::bad_alloc.
    void Read(std::string_view piece);

    /// Call this once, at the end. Errors: std::bad_alloc.
    const TWbemAnswer& Finish();

    /// Why the bytes are no answer in CIM-XML: what was found and what was expected; empty if they are one. Call this after Finish.
    std::string DescribeFault() const;
    /// Whether they are none because they end early.
    bool IsCutOff() const { return fIsFaulty && fReader.IsCutOff() && !IsPage(); }

  private:
    void OnStart(const char* name, const char** attributes) override;
    void OnEnd(const char* name) override;
    void OnText(const char* text, std::size_t length) override { fText = std::string_view(text, length); }

    void BeginMember(std::string_view name, const char** attributes);
    bool IsPage() const;

    std::function<void()> fOnInstance;
    TXmlReader fReader;
    TWbemAnswer fAnswer;
    std::string fBeginning;        // of the bytes
    std::size_t fDepth = 0;        // open elements
    std::size_t fAnswerDepth = 0;  // of IMETHODRESPONSE; 0 outside of it
    std::string fRoot;             // the outermost element
    std::string fOutput;           // the parameter that is open
    bool fIsReturnOpen = false;    // within IRETURNVALUE
    bool fIsKeyName = false;       // within the key "Name" of an instance name
    bool fIsFaulty = false;
    bool fHasEnded = false;  // the outermost element
    std::string_view fText;  // in front of the next tag
};

}  // namespace NORVZEL20
