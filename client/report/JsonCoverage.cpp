#include "client/report/JsonCoverage.h"

#include <utility>

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

const char* StateName(TCoverage::EState state)
{
    switch (state) {
    case TCoverage::kCompared:
        return "compared";
    case TCoverage::kExcludedByRules:
        return "excludedByRules";
    case TCoverage::kReachedByNoElement:
        return "reachedByNoElement";
    case TCoverage::kLeftOutByOptions:
        return "leftOutByOptions";
    case TCoverage::kNothingToCompare:
        return "nothingToCompare";
    case TCoverage::kUnknownToReference:
        return "unknownToReference";
    default:
        return "madeByCimdelta";
    }
}

const char* NoteName(TSchemaNote::EKind kind)
{
    switch (kind) {
    case TSchemaNote::kClassDeclared:
        return "classDeclared";
    case TSchemaNote::kPropertyDeclared:
        return "propertyDeclared";
    case TSchemaNote::kClassRespelled:
        return "classRespelled";
    case TSchemaNote::kPropertyRespelled:
        return "propertyRespelled";
    case TSchemaNote::kOperatingSystemMade:
        return "operatingSystemMade";
    case TSchemaNote::kTypeDiffers:
        return "typeDiffers";
    case TSchemaNote::kArrayTypeDiffers:
        return "arrayTypeDiffers";
    case TSchemaNote::kSuperClassDiffers:
        return "superClassDiffers";
    case TSchemaNote::kSpellingDiffers:
        return "spellingDiffers";
    default:
        return "keysDiffer";
    }
}

const char* ReasonName(TCoverage::EReason reason)
{
    switch (reason) {
    case TCoverage::EReason::kUsedAsKey:
        return "usedAsKey";
    case TCoverage::EReason::kNotDeclared:
        return "notDeclared";
    case TCoverage::EReason::kTimeOfCollection:
        return "timeOfCollection";
    case TCoverage::EReason::kLeftOutByOptions:
        return "leftOutByOptions";
    default:
        return "excludedByRules";
    }
}

TJson JsonOfCoveredClass(const TComparisonReport& report, const TCoverage::TClass& cls)
{
    TJson leftOut = TJson::array();
    TJson reasons = TJson::array();
    for (const TCoverage::TLeftOut& property : cls.leftOut) {
        leftOut.push_back(property.property);
        reasons.push_back({{"property", property.property}, {"reason", ReasonName(property.reason)}});
    }
    TJson json = {{"class", cls.name},
                  {"state", StateName(cls.state)},
                  {"instances", cls.instances},
                  {"propertiesLeftOut", leftOut},
                  {"excludedKeys", cls.excludedKeys},
                  {"sharingKeys", cls.sharing},
                  {"instancesCompared", cls.compared},
                  {"ignoredKeys", cls.ignoredKeys},
                  {"sharingKeysWithoutPartner", cls.sharingAlone},
                  {"referencesReduced", cls.reducedReferences},
                  {"referenceKeysLeftOut", cls.referenceKeys},
                  {"leftOutReasons", reasons}};
    if (!cls.madeIn.empty()) {
        TJson labels = TJson::array();
        for (const std::size_t inventory : cls.madeIn) {
            labels.push_back(report.labels[inventory]);
        }
        json["madeIn"] = std::move(labels);
    }
    return json;
}

TJson JsonOfNote(const TComparisonReport& report, const TSchemaNote& note)
{
    TJson json = {{"kind", NoteName(note.kind)},
                  {"inventory", report.labels[note.inventory]},
                  {"asIn", report.labels[note.source]},
                  {"class", note.className}};
    if (!note.property.empty()) {
        json["property"] = note.property;
    }
    if (!note.before.empty()) {
        json["before"] = note.before;
    }
    if (note.kind == TSchemaNote::kArrayTypeDiffers || note.kind == TSchemaNote::kSuperClassDiffers) {
        json["declared"] = note.declared;
        json["declaredAsIn"] = note.declaredInSource;
    }
    return json;
}

TJson JsonOfBadValues(const TComparisonReport& report, const TCoverage::TBadValues& bad)
{
    const TBadProperty& first = bad.found;
    return {{"inventory", report.labels[bad.inventory]},
            {"class", first.className},
            {"property", first.property},
            {"values", first.count},
            {"takenAs", first.isKeptAsText ? "text" : "null"},
            {"first",
             {{"text", first.text},
              {"type", first.type},
              {"instance", first.instance},
              {"file", first.document},
              {"line", first.line},
              {"column", first.column}}}};
}

TJson JsonOfName(const TComparisonReport& report, const TCoverage::TName& entry)
{
    TJson within = TJson::array();
    for (const auto& [key, count] : entry.name.within) {
        within.push_back({{"key", key}, {"texts", count}});
    }
    return {{"inventory", report.labels[entry.inventory]}, {"name", entry.name.name},
            {"comparedAs", entry.name.comparedAs},         {"texts", entry.name.replaced},
            {"anotherSystem", entry.name.marked},          {"withinLongerTexts", within}};
}

TJson JsonOfLack(const TComparisonReport& report, const TCoverage::TLack& lack)
{
    return {{"inventory", report.labels[lack.inventory]},
            {"kind", lack.what.kind},
            {"reason", lack.what.reason},
            {"count", lack.what.count},
            {"subjects", lack.what.subjects}};
}

TJson JsonOfHints(const TCoverage& coverage)
{
    TJson hints = TJson::array();
    if (coverage.hint) {
        hints.push_back({{"kind", "systemName"},
                         {"class", coverage.hint->className},
                         {"property", coverage.hint->property},
                         {"instances", coverage.hint->instances}});
    }
    return hints;
}

}  // namespace

nlohmann::ordered_json JsonOfCoverage(const TComparisonReport& report)
{
    TJson classes = TJson::array();
    for (const TCoverage::TClass& cls : report.coverage.classes) {
        classes.push_back(JsonOfCoveredClass(report, cls));
    }
    TJson notes = TJson::array();
    for (const TSchemaNote& note : report.coverage.notes) {
        notes.push_back(JsonOfNote(report, note));
    }
    TJson badValues = TJson::array();
    for (const TCoverage::TBadValues& bad : report.coverage.badValues) {
        badValues.push_back(JsonOfBadValues(report, bad));
    }
    TJson names = TJson::array();
    for (const TCoverage::TName& name : report.coverage.names) {
        names.push_back(JsonOfName(report, name));
    }
    TJson lacks = TJson::array();
    for (const TCoverage::TLack& lack : report.coverage.lacks) {
        lacks.push_back(JsonOfLack(report, lack));
    }
    TJson json = {{"classes", classes},   {"classesWithoutInstances", report.coverage.classesWithout},
                  {"schema", notes},      {"badValues", badValues},
                  {"systemNames", names}, {"hints", JsonOfHints(report.coverage)}};
    if (!lacks.empty()) {
        json["notCollected"] = lacks;
    }
    return json;
}

}  // namespace NORVZEL20
