// The prediction. A line of a recorded call says what the run was doing:
//
//   up to the last call for KALMO_OperatingSystem    the check of the operating systems
//   from there to the first call for "<root>"        the specification: class tags, value tags, rules pushed down
//   from there on                                    the comparison
//
// The phase decides the status and the log entries of a failure. The number of records is that of the KALMO_ instances added by
// then.

#include "tests/faults/TRunCalls.h"

#include <algorithm>
#include <sstream>

#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

using EStatus = TRunCalls::EStatus;

bool Contains(const std::string& text, const std::string& part)
{
    return text.find(part) != std::string::npos;
}

/// The text between the first two quotes.
std::string QuotedIn(const std::string& line)
{
    const std::size_t begin = line.find('"') + 1;
    return line.substr(begin, line.find('"', begin) - begin);
}

std::string OutcomeWith(EStatus status)
{
    return "status " + std::to_string(status);
}

std::string FatalError(const std::string& line, const std::string& message)
{
    return "0|Diff-XML Parser line " + line + ":" + message + "\n|";
}

std::string PassedOn(const std::string& line, bool isStart, EStatus status)
{
    const std::string event = isStart ? "Thrown exception in StartElement " : "Threw exception in EndElement";
    return "0|TDiffXMLParser: " + event + TZELException(status).what() + " on line " + line + "|";
}

}  // namespace

TRunCalls::TRunCalls(const std::string& lines, const std::string& rules) : fRules(rules)
{
    std::istringstream in(lines);
    for (std::string line; std::getline(in, line);) {
        fLines.push_back(line);
    }
    while (!Contains(GetLine(fFirstCompared), "<root>")) {
        ++fFirstCompared;
    }
    fFirstOfSpecification = fFirstCompared;
    while (!Contains(GetLine(fFirstOfSpecification - 1), "KALMO_OperatingSystem")) {
        --fFirstOfSpecification;
    }
}

std::string TRunCalls::GetLine(std::size_t call) const
{
    return call == 0 || call > fLines.size() ? "none" : fLines[call - 1];
}

std::size_t TRunCalls::CountRecordsBefore(std::size_t call) const
{
    const auto isRecord = [](const std::string& line) {
        return line.compare(0, 16, "store:new KALMO_") == 0 && Contains(line, ".AddToNamespace(");
    };
    const auto end = fLines.begin() + static_cast<std::ptrdiff_t>(call - 1);
    return static_cast<std::size_t>(std::count_if(fLines.begin(), end, isRecord));
}

TRunCalls::TEnd TRunCalls::WhenFails(std::size_t call, EStatus status) const
{
    const EPhase phase = PhaseOf(call);
    if (phase == kOperatingSystems) {
        return {OutcomeWith(EStatus::kInitializationFailed),
                "0|TCIMDiffEngine: Failed to get all properties to check Schema match\n|"};
    }
    if (status == EStatus::kNotFound && phase != kPushingDown) {
        return WhenNotFound(call);
    }
    const std::string log = phase == kComparing ? "" : PassedOn(LineInRules(call), phase == kClassTag, status);
    return {OutcomeWith(status), log};
}

TRunCalls::EPhase TRunCalls::PhaseOf(std::size_t call) const
{
    if (call < fFirstOfSpecification) {
        return kOperatingSystems;
    }
    if (call >= fFirstCompared) {
        return kComparing;
    }
    if (IsOfClassTag(call)) {
        return kClassTag;
    }
    return Contains(GetLine(call) + GetLine(call + 1), ".GetPropertyDecl(") ? kValueTag : kPushingDown;
}

/// After a start tag the next call is for another class. A value's end tag asks for a property next, the last end tag for
/// subclasses.
bool TRunCalls::IsOfClassTag(std::size_t call) const
{
    return Contains(GetLine(call), ".GetClass(\"") && Contains(GetLine(call + 1), ".GetClass(\"");
}

/// The line of the class element that is being read.
std::string TRunCalls::LineInRules(std::size_t call) const
{
    while (!IsOfClassTag(call)) {
        --call;
    }
    const auto end = fRules.begin() + static_cast<std::ptrdiff_t>(fRules.find("'" + QuotedIn(GetLine(call)) + "'"));
    return std::to_string(1 + std::count(fRules.begin(), end, '\n'));
}

std::string TRunCalls::PropertyOf(std::size_t call) const
{
    return QuotedIn(GetLine(Contains(GetLine(call), ".GetPropertyDecl(") ? call : call + 1));
}

/// To some calls, kNotFound (15) is an answer and not a failure.
TRunCalls::TEnd TRunCalls::WhenNotFound(std::size_t call) const
{
    const EPhase phase = PhaseOf(call);
    if (phase == kComparing) {
        return WhenNotFoundComparing(GetLine(call));
    }
    const std::string line = LineInRules(call);
    const std::string error = phase == kClassTag ? "Class specified on line " + line + " was not found in the schema"
                                                 : "Invalid property \"" + PropertyOf(call) + "\" specified on line " + line;
    return {OutcomeWith(EStatus::kParseError), FatalError(line, error) + PassedOn(line, phase == kClassTag, EStatus::kParseError)};
}

/// The store may lack a class; if the context has an index, the compared namespace is asked instead. A namespace may lack a class
/// without instances in the reference, such as Ghost.
TRunCalls::TEnd TRunCalls::WhenNotFoundComparing(const std::string& line) const
{
    const bool hasIndex = Contains(line, "nsIndex");
    if (line.compare(0, 15, "store.GetClass(") == 0) {
        return {hasIndex ? "" : OutcomeWith(EStatus::kMissingParameter), ""};
    }
    const bool checksSchema = Contains(line, ".GetClass(\"") && !hasIndex && line[2] != '0';
    if (!checksSchema) {
        return {OutcomeWith(EStatus::kNotFound), ""};
    }
    const std::string name = QuotedIn(line);
    if (name == "Ghost") {
        return {"", ""};
    }
    return {OutcomeWith(EStatus::kSchemaMismatch),
            "0|TCIMDiffEngine: Schema do not match. (Couldn't find class " + name + " in namespace " + line[2] + ")\n|"};
}

}  // namespace NORVZEL20
