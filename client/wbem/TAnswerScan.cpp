// An answer is
//
//     CIM > MESSAGE > SIMPLERSP > IMETHODRESPONSE NAME > ERROR CODE DESCRIPTION
//                                                      > IRETURNVALUE > VALUE.NAMEDINSTANCE, VALUE.INSTANCEWITHPATH, INSTANCE
//                                                                     > INSTANCENAME > KEYBINDING NAME > KEYVALUE
//                                                      > PARAMVALUE NAME > VALUE
//
// Instances embed other instances and names, so only children of IRETURNVALUE count, and only keys of names that are such children.
#include "client/wbem/TAnswerScan.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <cstring>
#include <utility>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const std::size_t kKeptBytes = 400;

// Empty if there is no such attribute.
std::string AttributeOf(const char** attributes, const char* name)
{
    for (const char** next = attributes; *next != nullptr; next += 2) {
        if (std::strcmp(next[0], name) == 0) {
            return next[1];
        }
    }
    return std::string();
}

}  // namespace

TAnswerScan::TAnswerScan(std::function<void()> onInstance) : fOnInstance(std::move(onInstance)), fReader(*this)
{
    fReader.Reset();
}

void TAnswerScan::Read(std::string_view piece)
{
    fBeginning += piece.substr(0, kKeptBytes - std::min(kKeptBytes, fBeginning.size()));
    if (!fIsFaulty) {
        fIsFaulty = !fReader.Parse(piece.data(), piece.size());
    }
}

const TWbemAnswer& TAnswerScan::Finish()
{
    fIsFaulty = fIsFaulty || !fReader.Finish();
    fAnswer.isComplete = !fIsFaulty && fHasEnded;
    return fAnswer;
}

std::string TAnswerScan::DescribeFault() const
{
    if (fBeginning.find_first_not_of(" \t\r\n") == std::string::npos) {
        return "found an empty answer, expected CIM-XML";
    }
    if (IsPage()) {
        return "found a web page, expected CIM-XML; is this the port of a WBEM server? Those are usually 5989 (https) and 5988 "
               "(http)";
    }
    if (IsCutOff()) {
        return "found an answer that ends early";
    }
    if (fIsFaulty) {
        const TTextPlace place = fReader.GetPlace();
        return "found an answer that is no XML (" + EscapeForDisplay(fReader.GetError()) + " in line " +
               std::to_string(place.line) + "), expected CIM-XML: " + QuoteForDisplay(fBeginning.substr(0, 60));
    }
    if (fRoot != "CIM") {
        return "found <" + EscapeForDisplay(fRoot) + ">, expected <CIM>";
    }
    return fAnswer.operation.empty() ? "found no <IMETHODRESPONSE>, expected the answer to a request" : std::string();
}

bool TAnswerScan::IsPage() const
{
    const std::size_t first = std::min(fBeginning.size(), fBeginning.find_first_not_of(" \t\r\n\xef\xbb\xbf"));
    const std::string_view text = std::string_view(fBeginning).substr(first);
    return boost::algorithm::istarts_with(text, "<html") || boost::algorithm::istarts_with(text, "<!doctype html") ||
           boost::algorithm::iequals(fRoot, "html");
}

void TAnswerScan::OnStart(const char* name, const char** attributes)
{
    fText = std::string_view();
    ++fDepth;
    const std::string_view element(name);
    if (fDepth == 1) {
        fRoot = element;
    }
    if (fAnswerDepth == 0) {
        if (element == "IMETHODRESPONSE") {
            fAnswerDepth = fDepth;
            fAnswer.operation = AttributeOf(attributes, "NAME");
        }
        return;
    }
    if (fDepth == fAnswerDepth + 1) {
        fIsReturnOpen = element == "IRETURNVALUE";
        fOutput = element == "PARAMVALUE" ? AttributeOf(attributes, "NAME") : std::string();
        if (element == "ERROR") {
            fAnswer.errorCode = AttributeOf(attributes, "CODE");
            fAnswer.description = AttributeOf(attributes, "DESCRIPTION");
        }
    } else if (fIsReturnOpen && fDepth <= fAnswerDepth + 3) {
        BeginMember(element, attributes);
    }
}

void TAnswerScan::BeginMember(std::string_view name, const char** attributes)
{
    if (fDepth == fAnswerDepth + 3) {
        fIsKeyName = name == "KEYBINDING" && boost::algorithm::iequals(AttributeOf(attributes, "NAME"), "Name");
        return;
    }
    if (name == "VALUE.NAMEDINSTANCE" || name == "VALUE.INSTANCEWITHPATH" || name == "INSTANCE") {
        ++fAnswer.instances;
        if (fOnInstance) {
            fOnInstance();
        }
    }
}

void TAnswerScan::OnEnd(const char* name)
{
    const std::string_view element(name);
    if (fIsKeyName && fDepth == fAnswerDepth + 4 && element == "KEYVALUE") {
        fAnswer.names.emplace_back(fText);
    }
    if (fAnswerDepth != 0 && fDepth == fAnswerDepth + 2 && element == "VALUE") {
        if (fOutput == "EnumerationContext") {
            fAnswer.context = fText;
        } else if (fOutput == "EndOfSequence") {
            fAnswer.isEndOfSequence = boost::algorithm::iequals(fText, "TRUE");
        }
    }
    if (fDepth == fAnswerDepth) {
        fAnswerDepth = 0;
    }
    fText = std::string_view();
    --fDepth;
    fHasEnded = fDepth == 0;
}

}  // namespace NORVZEL20
