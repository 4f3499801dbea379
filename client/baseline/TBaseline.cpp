// The file is made for people and for merging: one line an entry, sorted, nothing in it that depends on other entries. So two
// people who accept different differences change different lines.
//
//   cimdelta-baseline 1
//   # Accepted differences. ...
//
//   ~ Disk.Id="sda" Size: uint64 500 -> uint64 250 in web02, web03  # replaced in June
#include "client/baseline/TBaseline.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "client/baseline/EntryText.h"
#include "client/baseline/ForEachUnquoted.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

const char kExplanation[] = "# Accepted differences, one a line. What stands behind # is the reason.";

std::string PropertyOf(const TAcceptedDifference& entry)
{
    return entry.kind == TDifference::kChanged ? entry.values.front().property : std::string();
}

// Names count in any letter case, the values of keys as they are. TRUE, FALSE and numbers have one spelling each.
std::string AboutText(TDifference::EKind kind, const std::string& instance, const std::string& property)
{
    std::string names = instance;
    ForEachUnquoted(instance, [&names](std::size_t at) {
        names[at] = TNameText::ToLower(names[at]);
        return true;
    });
    return SignOf(kind) + names + '\n' + TNameText::ToLower(property);
}

bool HaveCommon(const std::vector<std::string>& one, const std::vector<std::string>& other)
{
    return std::any_of(one.begin(), one.end(),
                       [&](const std::string& label) { return std::binary_search(other.begin(), other.end(), label); });
}

}  // namespace

std::optional<std::size_t> TBaseline::Add(TAcceptedDifference entry)
{
    std::vector<std::size_t>& about = fAbout[AboutText(entry.kind, entry.instance, PropertyOf(entry))];
    std::optional<std::size_t> same;
    for (const std::size_t position : about) {
        if (fEntries[position].values == entry.values) {
            same = position;
        } else if (HaveCommon(entry.inventories, fEntries[position].inventories)) {
            return position;
        }
    }
    if (same) {
        Join(fEntries[*same], entry);
    } else {
        about.push_back(fEntries.size());
        fEntries.push_back(std::move(entry));
    }
    return std::nullopt;
}

void TBaseline::Join(TAcceptedDifference& entry, const TAcceptedDifference& other)
{
    std::vector<std::string> labels;
    std::set_union(entry.inventories.begin(), entry.inventories.end(), other.inventories.begin(), other.inventories.end(),
                   std::back_inserter(labels));
    entry.inventories = std::move(labels);
    const auto listed = [](const std::string& reasons) { return "; " + reasons + "; "; };
    if (!other.reason.empty() && listed(entry.reason).find(listed(other.reason)) == std::string::npos) {
        entry.reason += (entry.reason.empty() ? "" : "; ") + other.reason;
    }
    for (const std::string& comment : other.comments) {
        if (std::find(entry.comments.begin(), entry.comments.end(), comment) == entry.comments.end()) {
            entry.comments.push_back(comment);
        }
    }
}

const std::vector<std::size_t>& TBaseline::About(TDifference::EKind kind, const std::string& instance,
                                                 const std::string& property) const
{
    static const std::vector<std::size_t> fgNone;
    const auto found = fAbout.find(AboutText(kind, instance, property));
    return found == fAbout.end() ? fgNone : found->second;
}

std::optional<std::size_t> TBaseline::Find(TDifference::EKind kind, const std::string& instance, const std::string& property,
                                           const std::string& label) const
{
    for (const std::size_t position : About(kind, instance, property)) {
        const std::vector<std::string>& labels = fEntries[position].inventories;
        if (std::binary_search(labels.begin(), labels.end(), label)) {
            return position;
        }
    }
    return std::nullopt;
}

std::string TBaseline::ToText() const
{
    std::vector<std::pair<std::string, std::size_t>> order;
    for (std::size_t i = 0; i < fEntries.size(); ++i) {
        const TAcceptedDifference& entry = fEntries[i];
        order.emplace_back(entry.instance + '\n' + PropertyOf(entry) + '\n' + EntryText(entry), i);
    }
    std::sort(order.begin(), order.end());
    std::string text = std::string(kBaselineMark) + " " + kBaselineVersion + "\n";
    for (const std::string& comment : fComments.empty() ? std::vector<std::string>{kExplanation} : fComments) {
        text += comment + "\n";
    }
    text += "\n";
    for (const auto& [place, position] : order) {
        const TAcceptedDifference& entry = fEntries[position];
        for (const std::string& comment : entry.comments) {
            text += comment + "\n";
        }
        text += EntryText(entry) + (entry.reason.empty() ? "" : "  # " + entry.reason) + "\n";
    }
    return text;
}

}  // namespace NORVZEL20
