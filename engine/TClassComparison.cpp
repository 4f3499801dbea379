#include "engine/TClassComparison.h"

#include <string>
#include <utility>

#include "engine/Borrow.h"
#include "engine/TInstanceWalk.h"
#include "engine/TMessageStream.h"
#include "host/TAddToVectorCallback.h"
#include "host/TRootObject.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

namespace {

std::vector<boost::shared_ptr<ICIMInstance>> GetInstances(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    cls.EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, TCallContext());
    return instances;
}

std::vector<boost::shared_ptr<ICIMProperty>> GetProperties(const ICIMInstance& instance)
{
    std::vector<boost::shared_ptr<ICIMProperty>> properties;
    instance.EnumerateProperties(TAddToVectorCallback<ICIMProperty>(&properties), TCallContext());
    return properties;
}

void MarkPropertiesRemoved(const ICIMInstance& instance)
{
    for (const boost::shared_ptr<ICIMProperty>& property : GetProperties(instance)) {
        // A null is no value that the other namespace could lack.
        if (!property->GetValue(TCallContext()).IsNull()) {
            property->MarkRemoved();
        }
    }
}

}  // namespace

TCIMDiffEngine::TClassComparison::TClassComparison(TCIMDiffEngine& engine, boost::shared_ptr<ICIMClass> cls)
    : fEngine(engine), fClass(std::move(cls)), fClassName(fClass->GetName(TCallContext())),
      fRules(engine.ruleset.getClassRules(fClassName)), fProperties(engine.buildPropList(fRules, fClass))
{}

// (1) Index the reference's instances of the class by key.
// (2) Match the instances of each other namespace with them. A key that the other namespace lacks is absent, a key that the
//     reference lacks is missing, and properties of matched instances may differ.
// (3) If nothing is absent, missing or different, write nothing. Otherwise write the class's record.
// (4) Write a record for each absent instance.
// (5) Write a record for each missing instance.
// (6) Write a record for each property that differs. The records of each of these steps are in the order of the keys.
//
// With exactly two namespaces, (2) also overwrites values of the reference, (4) marks the values of absent instances as removed,
// and (5) copies missing instances into the reference.
void TCIMDiffEngine::TClassComparison::Run()
{
    if (fProperties.empty()) {
        return;
    }
    CollectReferenceInstances();
    for (std::size_t index = 1; index < fEngine.namespaces.size(); ++index) {
        CompareWithNamespace(index);
    }
    const bool excludesKeys = fRules->hasExcludedKeys();
    if (!IsAnythingDifferent()) {
        return;
    }
    CreateClassRecord();
    RecordAbsentInstances(excludesKeys);
    RecordMissingInstances();
    RecordDifferences();
}

void TCIMDiffEngine::TClassComparison::CollectReferenceInstances()
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances = GetInstances(*fClass);
    fEngine.buildInstanceMap(fRules, instances, fMaster);
}

void TCIMDiffEngine::TClassComparison::CompareWithNamespace(std::size_t index)
{
    if (!FindClassIn(index)) {
        return;
    }
    const TCompareInstances compareInstances(&fEngine, fRules, &fMaster, &fMissing, &fDifferences, static_cast<unsigned int>(index),
                                             &fProperties);
    TInstanceWalk::TState state{TMasterCursor(fMaster), TIndicesCursor(fMissing)};
    fOtherClass->EnumerateInstances(TInstanceWalk(compareInstances, &state), false, TCallContext());
    NoteAbsentInstances(index);
}

/// Whether the namespace has the class. If it lacks the class although the reference has instances of it, the run fails.
bool TCIMDiffEngine::TClassComparison::FindClassIn(std::size_t index)
{
    try {
        fOtherClass = fEngine.namespaces[index]->GetClass(fClassName, TCallContext());
        return true;
    } catch (const TZELException& error) {
        if (error.GetStatusCode() != TZELStatusCode::kNotFound) {
            // Only the status is passed on, because the caller may not know the type of the host's exception.
            throw TZELException(error.GetStatusCode());
        }
    }
    if (!fMaster.empty()) {
        FailWithoutClassIn(index);
    }
    return false;
}

void TCIMDiffEngine::TClassComparison::FailWithoutClassIn(std::size_t index) const
{
    TMessageStream text;
    text << "TCIMDiffEngine: Schema do not match. (Couldn't find class " << fClassName << " in namespace " << index << ")"
         << std::endl;
    TRootObject::GetCoreLogger()->Log(0, text.str());
    throw TZELException(TZELStatusCode::kSchemaMismatch);
}

void TCIMDiffEngine::TClassComparison::NoteAbsentInstances(std::size_t index)
{
    TIndicesCursor absent(fAbsent);
    for (auto& [key, master] : fMaster) {
        if (master.found == 0) {
            absent.FindOrAdd(std::string(key)).second.push_back(static_cast<int>(index));
        }
        // The next namespace starts with no instance found.
        master.found = 0;
    }
}

bool TCIMDiffEngine::TClassComparison::IsAnythingDifferent() const
{
    return !fAbsent.empty() || !fMissing.empty() || !fDifferences.empty();
}

void TCIMDiffEngine::TClassComparison::CreateClassRecord()
{
    fClassRecord = fEngine.AllocateRecord(kClassRecord);
    SetProperty(*fClassRecord, kClassRecordName, TCIMValue(fClassName));
    fClassRecord->AddToNamespace(TCallContext());
}

void TCIMDiffEngine::TClassComparison::RecordAbsentInstances(bool excludesKeys)
{
    TMasterCursor masters(fMaster);
    for (const auto& [key, indices] : fAbsent) {
        const ICIMInstance& instance = *masters.Find(key)->second.instance;
        RecordAbsentInstance(key, instance, indices, excludesKeys);
        if (HasTwoNamespaces()) {
            MarkPropertiesRemoved(instance);
        }
    }
}

/// If keys are excluded, the record names the instance by its whole path, because several instances may share the key.
void TCIMDiffEngine::TClassComparison::RecordAbsentInstance(const std::string& key, const ICIMInstance& instance,
                                                            const TIndices& indices, bool excludesKeys)
{
    if (!excludesKeys) {
        fEngine.createCIMDiff(fClassRecord, TDeltaNamespace::kInstanceRemoved, key, "", indices);
        return;
    }
    const TCIMReference path = instance.GetReference(TCallContext());
    fEngine.createObjectPathAlias(fClassName, key, path, 0);
    fEngine.createCIMDiff(fClassRecord, TDeltaNamespace::kInstanceRemoved, path.GetPath(), "", indices);
}

void TCIMDiffEngine::TClassComparison::RecordMissingInstances()
{
    std::map<std::string, TMasterInstance> others;
    if (HasTwoNamespaces()) {
        CollectMissingInstances(others);
    }
    TMasterCursor place(others);
    for (const auto& [key, indices] : fMissing) {
        fEngine.createCIMDiff(fClassRecord, TDeltaNamespace::kInstanceAdded, key, "", indices);
        if (HasTwoNamespaces()) {
            // If the other namespace has no such instance any more, this adds a null pointer, which fails the host's assertion.
            const auto* const other = place.Find(key);
            CopyToReference(other != nullptr ? other->second.instance : nullptr);
        }
    }
}

/// Indexes the other namespace's instances by the keys that they have now, but only under keys that are missing: no others are
/// asked for.
void TCIMDiffEngine::TClassComparison::CollectMissingInstances(std::map<std::string, TMasterInstance>& others)
{
    const boost::shared_ptr<TDiffClassRules> rules = Borrow(fRules);
    TIndicesCursor missing(fMissing);
    TMasterCursor place(others);
    for (const boost::shared_ptr<ICIMInstance>& instance : GetInstances(*fOtherClass)) {
        std::string key = fEngine.buildPath(rules, Borrow(instance));
        if (missing.Find(key) == nullptr) {
            continue;
        }
        TMasterInstance& other = place.FindOrAdd(std::move(key)).second;
        if (!other.instance) {
            other.instance = instance;
        }
    }
}

void TCIMDiffEngine::TClassComparison::CopyToReference(boost::shared_ptr<ICIMInstance> instance)
{
    const boost::shared_ptr<ICIMInstance> copy = fClass->AllocateInstance(TCallContext());
    for (const boost::shared_ptr<ICIMProperty>& property : GetProperties(*instance)) {
        const TCIMValue& value = property->GetValue(TCallContext());
        if (!value.IsNull()) {
            const boost::shared_ptr<const ICIMPropertyDecl> decl = property->GetPropertyDecl(TCallContext());
            SetProperty(*copy, decl->GetName(TCallContext()), value);
        }
    }
    copy->AddToNamespace(TCallContext());
}

void TCIMDiffEngine::TClassComparison::RecordDifferences()
{
    for (const auto& [key, properties] : fDifferences) {
        for (const auto& [name, indices] : properties) {
            fEngine.createCIMDiff(fClassRecord, TDeltaNamespace::kPropertyChanged, key, name, indices);
        }
    }
}

bool TCIMDiffEngine::TClassComparison::HasTwoNamespaces() const
{
    return fEngine.namespaces.size() == 2;
}

}  // namespace NORVZEL20
