// The document's own namespace and host.
//
// A reference into the namespace that it stands in is stored without that namespace, so two inventories are equal if only the name
// of their namespace or host differs. Which namespace that is, the document may say itself, before its first object, in the middle
// or never; and it may name the namespace without the host. What it does not say follows from its references:
//
//     namespace   the one that all of them name. If some name none, the one that all others name is either the own one, which the
//                 writer left out here and there, or a foreign one: it is the own one if any reference into it leads to an
//                 instance of the document. Otherwise the one that the options of the load give, or root/cimv2
//     host        the one that all of those name which name one beside that namespace; if they name several, none is known to be
//                 the own one, and all stay in the paths
//
// A document is read once, so both are known only at its end. Until then such references are open: they are stored as they are
// written, and written again after Decide. A reference without a namespace is never open, and neither is one without a host in a
// document that names its namespace first.
#include "embedded/load/TOwnPlaceSearch.h"

#include "embedded/value/ChangeReferences.h"

namespace NORVZEL20 {

TOwnPlaceSearch::EAnswer TOwnPlaceSearch::Classify(const std::string& name, const std::string& host)
{
    if (name.empty()) {
        fIsAnyNameless = true;
        return kForeign;
    }
    // What the document has named itself does not change any more.
    if (fIsDecided || (fReport.namesNamespace && (host.empty() || !fReport.host.empty()))) {
        return GetNamed().Contains(name, host) ? kOwn : kForeign;
    }
    if (fReport.namesNamespace && !TNameText::Equal(name, fReport.namespaceName)) {
        return kForeign;
    }
    THosts& hosts = fNamed[name];
    if (hosts.first.empty()) {
        hosts.first = host;
    }
    hosts.areSeveral = hosts.areSeveral || (!host.empty() && !TNameText::Equal(host, hosts.first));
    return kOpen;
}

bool TOwnPlaceSearch::MakeLocal(TCIMValue& value)
{
    bool isOpen = false;
    ChangeReferences(value, [&](TCIMValue& path) { return MakePathLocal(path, isOpen); });
    return isOpen;
}

/// Returns whether the path changed.
bool TOwnPlaceSearch::MakePathLocal(TCIMValue& value, bool& isOpen)
{
    const TCIMReference path = value;
    TCIMReference local(path);
    bool isChanged = false;
    path.EnumerateKeyBindings([&](std::pair<std::string, TCIMValue> key) {
        if (ChangeReferences(key.second, [&](TCIMValue& inner) { return MakePathLocal(inner, isOpen); })) {
            local.AddKeyValue(key.first, key.second);
            isChanged = true;
        }
        return true;
    });
    const EAnswer answer = Classify(path.GetNamespaceName(), path.GetHost());
    if (answer == kOwn) {
        local.SetNamespaceName("");
        local.SetHost("");
        isChanged = true;
    }
    isOpen = isOpen || answer == kOpen;
    if (isChanged) {
        value = TCIMValue(local);
    }
    return isChanged;
}

void TOwnPlaceSearch::Decide(bool leadsHere)
{
    fReport.referencesNameNamespace = HasOpen();
    if (!fReport.namesNamespace) {
        for (const auto& named : fNamed) {
            fReport.namespacesOfReferences.push_back(named.first);
        }
        if (fNamed.size() == 1 && (leadsHere || !fIsAnyNameless)) {
            fReport.namespaceName = fNamed.begin()->first;
            fReport.namespaceOrigin = TLoadReport::kFromReferences;
        }
    }
    const auto own = fNamed.find(fReport.namespaceName);
    fIsAnyHostOwn = fReport.host.empty() && (own == fNamed.end() || !own->second.areSeveral);
    fIsDecided = true;
}

TOwnPlace TOwnPlaceSearch::GetNamed() const
{
    return {fReport.namespaceName, fReport.host, fIsAnyHostOwn};
}

}  // namespace NORVZEL20
