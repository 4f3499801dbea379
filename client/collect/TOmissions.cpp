#include "client/collect/TOmissions.h"

namespace NORVZEL20 {

void TOmissions::Add(const std::string& kind, const std::string& reason, const std::string& subject, const std::string& advice)
{
    TSubjects& subjects = fSubjects[{kind, reason}];
    ++subjects.count;
    subjects.advice = advice;
    if (subjects.named.size() < kMostSubjects) {
        subjects.named.push_back(subject);
    }
}

std::vector<TFacts> TOmissions::MakeFacts() const
{
    std::vector<TFacts> facts;
    for (const auto& [key, subjects] : fSubjects) {
        TFacts lack("KALMO_NotCollected");
        lack.Key("Kind", key.first).Key("Reason", key.second).Number("Count", subjects.count).Texts("Subjects", subjects.named);
        if (subjects.count > subjects.named.size()) {
            lack.Number("Others", subjects.count - subjects.named.size());
        }
        facts.push_back(lack);
    }
    return facts;
}

std::string TOmissions::Describe(const TSubjects& subjects)
{
    constexpr std::size_t kMost = 3;
    std::string text;
    const std::size_t shown = subjects.count <= kMost + 1 ? subjects.count : kMost;
    for (std::size_t i = 0; i < shown; ++i) {
        text += (i == 0 ? "" : ", ") + subjects.named[i];
    }
    return subjects.count == shown ? text : text + " and " + std::to_string(subjects.count - shown) + " others";
}

std::vector<std::string> TOmissions::MakeLines() const
{
    std::vector<std::string> lines;
    std::string kind;
    for (const auto& [key, subjects] : fSubjects) {
        const std::string text =
            Describe(subjects) + ": " + key.second + (subjects.advice.empty() ? "" : " (" + subjects.advice + ")");
        if (lines.empty() || key.first != kind) {
            lines.push_back("not collected: " + key.first + ": " + text);
        } else {
            lines.back() += "; " + text;
        }
        kind = key.first;
    }
    return lines;
}

}  // namespace NORVZEL20
