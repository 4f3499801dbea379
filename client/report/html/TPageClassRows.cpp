#include "client/report/html/TPageClassRows.h"

#include <algorithm>
#include <utility>

#include "client/findings/ChangeIdentity.h"
#include "client/findings/DeclaredWords.h"
#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kNamesOfExample = 12;

std::size_t FewestIn(const TValueDifference& change)
{
    std::size_t fewest = change.others.front().inventories.size();
    for (const TValueDifference::TGroup& group : change.others) {
        fewest = std::min(fewest, group.inventories.size());
    }
    return fewest;
}

}  // namespace

TPageClassRows::TPageClassRows(const TComparisonReport& report, const TLacking& lacking, TShortNames& names, TPageData& data,
                               const std::string& className)
    : fLacking(lacking), fNames(names), fData(data), fChanges(data, report), fReportInventories(*report.inventories),
      fInventories(report.labels.size())
{
    fClass.name = className;
    fClass.differences.assign(fInventories, 0);
    fClass.instances.assign(fInventories, 0);
}

void TPageClassRows::Add(const TDifference& difference, std::size_t number)
{
    AddInstance(difference);
    Count(difference);
    if (difference.kind != TDifference::kChanged) {
        return AddPresence(difference, number);
    }
    AddChange(difference, difference.values.front(), number);
}

// Differences of one instance follow each other.
void TPageClassRows::AddInstance(const TDifference& difference)
{
    if (!fHasInstance || fInstance != difference.instance) {
        fHasInstance = true;
        fInstance = difference.instance;
        fCounted.assign(fInventories, false);
        fInstances.push_back({fData.texts.Add(fNames.Of(difference)), fData.texts.Add(EscapeForDisplay(difference.GetKeyText()))});
    }
    TInstance& instance = fInstances.back();
    if (const auto lacking = fLacking.find(difference.instance); lacking != fLacking.end()) {
        instance.lacking = fData.sets.Add(lacking->second);
    } else if (difference.kind == TDifference::kOnlyInReference) {
        instance.lacking = fData.sets.Add(difference.inventories);
    }
    if (difference.IsKeyShared()) {  // a page shows the inventories that agree as well
        instance.sharing = fChanges.AddList(difference.sharing);
    }
    if (!difference.path.empty()) {
        instance.path = fData.texts.Add(EscapeForDisplay(difference.path));
    }
}

void TPageClassRows::Count(const TDifference& difference)
{
    fCounter.Add(difference);
    for (const std::size_t inventory : difference.inventories) {
        ++fClass.differences[inventory];
        fClass.instances[inventory] += fCounted[inventory] ? 0 : 1;
        fCounted[inventory] = true;
    }
}

void TPageClassRows::AddPresence(const TDifference& difference, std::size_t number)
{
    const auto [place, isNew] = fPlaces.Add(difference);
    if (isNew) {
        fPresences.emplace_back();
        fPresences.back().page.kind = difference.kind;
    }
    TFinding& presence = fPresences[place];
    const std::size_t content = AddContents(difference, presence.page.example);
    AddRow(presence, difference, difference.inventories, content, number);
}

// The parts of a change stand for the whole.
void TPageClassRows::AddChange(const TDifference& difference, const TValueDifference& change, std::size_t number)
{
    if (!change.parts.empty()) {
        for (const TValueDifference& part : change.parts) {
            AddChange(difference, part, number);
        }
        return;
    }
    const std::vector<std::size_t> inventories = InventoriesOf(change);
    TFinding& finding = fProperties[{change.property, inventories}];
    finding.page.property = change.property;
    const auto [known, isNew] = finding.positions.emplace(WholeText(change), finding.changes.size());
    if (isNew) {
        if (finding.changes.empty()) {
            fChanges.Describe(change, WordsFor(change.property), finding.page.example);
        }
        finding.changes.push_back({fChanges.Add(change, true, WordsFor(change.property)), 0, FewestIn(change)});
    }
    ++finding.changes[known->second].rows;
    AddRow(finding, difference, inventories, known->second, number);
}

void TPageClassRows::AddRow(TFinding& finding, const TDifference& difference, const std::vector<std::size_t>& inventories,
                            std::size_t content, std::size_t number)
{
    finding.inventories = inventories;
    if (finding.page.example.names.size() < kNamesOfExample) {
        finding.page.example.names.push_back(CutForLine(fNames.Of(difference)));
    }
    finding.rows.push_back({fInstances.size() - 1, fData.sets.Add(inventories), content, number});
}

std::size_t TPageClassRows::AddContents(const TDifference& difference, TPageFinding::TExample& example)
{
    TPageColumns& columns = fData.columns;
    const std::size_t number = columns.GetCount(TPageColumns::kContentPairs);
    const bool isExample = example.names.empty();
    columns.Add(TPageColumns::kContentPairs, columns.GetCount(TPageColumns::kPairProperty));
    columns.Add(TPageColumns::kContentDisagreements, columns.GetCount(TPageColumns::kDisagreementProperty));
    for (const auto& [property, value] : difference.contents) {
        const std::string words = WordsFor(property).Describe(value);
        const std::string text = words.empty() ? DisplayContents(value) : words;
        columns.Add(TPageColumns::kPairProperty, fData.texts.Add(EscapeForDisplay(property)));
        columns.Add(TPageColumns::kPairValue, fData.texts.Add(text));
        if (isExample) {
            example.contents.emplace_back(EscapeForDisplay(property), CutForLine(text));
        }
    }
    AddDisagreements(difference);
    return number;
}

void TPageClassRows::AddDisagreements(const TDifference& difference)
{
    for (const TValueDifference& values : difference.values) {
        fData.columns.Add(TPageColumns::kDisagreementProperty, fData.texts.Add(EscapeForDisplay(values.property)));
        fData.columns.Add(TPageColumns::kDisagreementChange, fChanges.Add(values, false, WordsFor(values.property)));
    }
}

const TValueWords& TPageClassRows::WordsFor(const std::string& property)
{
    const auto known = fWords.find(property);
    return known != fWords.end() ? known->second
                                 : fWords.emplace(property, DeclaredWords(fReportInventories, fClass.name, property)).first->second;
}

void TPageClassRows::Write()
{
    TPageColumns& columns = fData.columns;
    const std::size_t firstInstance = columns.GetCount(TPageColumns::kInstanceName);
    for (const TInstance& instance : fInstances) {
        columns.Add(TPageColumns::kInstanceName, instance.name);
        columns.Add(TPageColumns::kInstanceKey, instance.key);
        columns.Add(TPageColumns::kInstanceLacking, instance.lacking);
        columns.Add(TPageColumns::kInstanceSharing, instance.sharing);
        columns.Add(TPageColumns::kInstancePath, instance.path);
    }
    std::stable_sort(fPresences.begin(), fPresences.end(),
                     [](const TFinding& one, const TFinding& other) { return one.page.kind < other.page.kind; });
    for (TFinding& presence : fPresences) {
        WriteFinding(presence, firstInstance);
    }
    for (auto& property : fProperties) {
        WriteFinding(property.second, firstInstance);
    }
    fClass.counts = fCounter.GetCounts();
    fData.classes.push_back(std::move(fClass));
}

// Changes that more instances have stand first.
void TPageClassRows::WriteFinding(TFinding& finding, std::size_t firstInstance)
{
    const std::vector<TChange>& changes = finding.changes;
    std::stable_sort(finding.rows.begin(), finding.rows.end(), [&changes](const TRow& one, const TRow& other) {
        if (changes.empty() || one.content == other.content) {
            return false;
        }
        const std::size_t ofOne = changes[one.content].rows;
        const std::size_t ofOther = changes[other.content].rows;
        return ofOne != ofOther ? ofOne > ofOther : one.content < other.content;
    });
    TPageColumns& columns = fData.columns;
    TPageFinding& page = finding.page;
    page.classNumber = fData.classes.size();
    page.set = fData.sets.Add(finding.inventories);
    page.firstRow = columns.GetCount(TPageColumns::kRowInstance);
    page.rows = finding.rows.size();
    page.changes = changes.size();
    page.rarity = Rarity(finding);
    for (const TRow& row : finding.rows) {
        columns.Add(TPageColumns::kRowInstance, firstInstance + row.instance);
        columns.Add(TPageColumns::kRowSet, row.set);
        columns.Add(TPageColumns::kRowContent, changes.empty() ? row.content : changes[row.content].number);
        columns.Add(TPageColumns::kRowDifference, row.difference);
    }
    fData.findings.push_back(std::move(page));
}

// An inventory has the reference's value if it neither differs nor lacks the instance.
std::size_t TPageClassRows::Rarity(const TFinding& finding) const
{
    std::size_t fewest = fInventories;
    for (const TRow& row : finding.rows) {
        const std::size_t differing = fData.sets.Get(row.set).size();
        const std::size_t lacking = finding.changes.empty() ? 0 : fData.sets.Get(fInstances[row.instance].lacking).size();
        const std::size_t agreeing = std::max<std::size_t>(1, fInventories - std::min(fInventories, differing + lacking));
        fewest = std::min({fewest, agreeing, finding.changes.empty() ? differing : finding.changes[row.content].fewest,
                           lacking > 0 ? lacking : fInventories});
    }
    return fewest;
}

}  // namespace NORVZEL20
