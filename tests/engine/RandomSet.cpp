#include "tests/engine/RandomSet.h"

#include <algorithm>
#include <random>

#include "tests/engine/NaiveRules.h"

namespace NORVZEL20 {

namespace {

using EKind = TNaiveValue::EKind;

// Makes one set. It uses no distributions of the library, whose results differ between libraries.
class TGenerator {
  public:
    TGenerator(const std::function<std::uint64_t()>& source, bool isStrict) : fSource(source), fIsStrict(isStrict) {}

    TNaiveSet Make();

  private:
    std::size_t Below(std::size_t bound) { return static_cast<std::size_t>(fSource() % bound); }
    bool OneIn(std::size_t count) { return Below(count) == 0; }
    template <class T>
    const T& OneOf(const std::vector<T>& choices)
    {
        return choices[Below(choices.size())];
    }

    void MakeSchema();
    TNaiveClass MakeClass(std::size_t number);
    TNaiveNamespace MakeNamespace(const TNaiveNamespace* reference);
    void DropSome(TNaiveNamespace& ns);
    void AddInstances(TNaiveNamespace& ns, const std::string& className);
    TNaiveValue MakeValue(const TNaiveProperty& property);
    TNaiveElement MakeElement();
    bool IsThere(const TNaiveNamespace& ns, const TNaiveInstance& instance);

    const std::function<std::uint64_t()>& fSource;
    bool fIsStrict;
    std::vector<TNaiveClass> fSchema;
};

TNaiveSet TGenerator::Make()
{
    MakeSchema();
    TNaiveSet set;
    const std::size_t count = OneIn(2) ? 2 : 1 + Below(5);
    for (std::size_t index = 0; index < count; ++index) {
        set.namespaces.push_back(MakeNamespace(index == 0 ? nullptr : &set.namespaces[0]));
    }
    const std::size_t elements = 1 + Below(4);
    for (std::size_t i = 0; i < elements; ++i) {
        set.rules.push_back(MakeElement());
    }
    return set;
}

void TGenerator::MakeSchema()
{
    fSchema.push_back({"KALMO_OperatingSystem", "", {{"Name", EKind::kText, true}, {"OSType", EKind::kNumber, false}}});
    const std::size_t count = 1 + Below(4);
    for (std::size_t number = 0; number < count; ++number) {
        fSchema.push_back(MakeClass(number));
    }
}

TNaiveClass TGenerator::MakeClass(std::size_t number)
{
    const std::string suffix = std::to_string(number);
    TNaiveClass cls{"C" + suffix, "", {}};
    if (number > 0 && !OneIn(3)) {
        cls.superName = "C" + std::to_string(Below(number));
    } else {
        cls.properties = {{"Key" + suffix, EKind::kText, true}, {"another" + suffix, EKind::kNumber, true}};
    }
    const std::vector<TNaiveProperty> choices = {{"Size" + suffix, EKind::kNumber, false},
                                                 {"Label" + suffix, EKind::kText, false},
                                                 {"Tags" + suffix, EKind::kList, false},
                                                 {"Owner" + suffix, EKind::kPath, false}};
    for (const auto& choice : choices) {
        if (!OneIn(3)) {
            cls.properties.push_back(choice);
        }
    }
    if (number == 0 && OneIn(3)) {
        cls.properties.push_back({"DateTimeOfCollection", EKind::kText, false});
    }
    return cls;
}

TNaiveNamespace TGenerator::MakeNamespace(const TNaiveNamespace* reference)
{
    TNaiveNamespace ns;
    ns.classes = fSchema;
    if (OneIn(reference ? 4 : 12)) {
        DropSome(ns);
    }
    for (const auto& cls : ns.classes) {
        AddInstances(ns, cls.name);
    }
    return ns;
}

// Leaves out a class without subclasses, or a property that is no key; sometimes the operating system.
void TGenerator::DropSome(TNaiveNamespace& ns)
{
    if (OneIn(8)) {
        ns.classes.erase(ns.classes.begin());
    } else if (OneIn(2) && ns.classes.size() > 2) {
        const auto& last = ns.classes.back();
        const auto isBelow = [&](const TNaiveClass& cls) { return cls.superName == last.name; };
        if (std::none_of(ns.classes.begin(), ns.classes.end(), isBelow)) {
            ns.classes.pop_back();
        }
    } else if (!ns.classes.back().properties.empty() && !ns.classes.back().properties.back().isKey) {
        ns.classes.back().properties.pop_back();
    }
}

void TGenerator::AddInstances(TNaiveNamespace& ns, const std::string& className)
{
    if (className == "KALMO_OperatingSystem") {
        TNaiveInstance system{className, {}, ""};
        system.values["Name"] = MakeValue({"Name", EKind::kText, true});
        system.values["OSType"].number = 36;
        system.values["OSType"].kind = EKind::kNumber;
        system.values["OSType"].isNull = false;
        ns.instances.push_back(system);
        return;
    }
    const std::size_t count = OneIn(3) ? 0 : Below(5);
    for (std::size_t i = 0; i < count; ++i) {
        TNaiveInstance instance{className, {}, ""};
        for (const auto& property : AllNaiveProperties(ns, className)) {
            instance.values[property.name] = MakeValue(property);
        }
        if (!fIsStrict || !IsThere(ns, instance)) {
            ns.instances.push_back(instance);
        }
    }
}

bool TGenerator::IsThere(const TNaiveNamespace& ns, const TNaiveInstance& instance)
{
    return std::any_of(ns.instances.begin(), ns.instances.end(), [&](const TNaiveInstance& other) {
        if (other.className != instance.className) {
            return false;
        }
        for (const auto& property : AllNaiveProperties(ns, instance.className)) {
            const auto& mine = instance.values.at(property.name);
            const auto& theirs = other.values.at(property.name);
            if (property.isKey && (mine.text != theirs.text || mine.number != theirs.number)) {
                return false;
            }
        }
        return true;
    });
}

TNaiveValue TGenerator::MakeValue(const TNaiveProperty& property)
{
    static const std::vector<std::string> kTexts = {"a", "b", "a\",another0=1", "\\", ""};
    TNaiveValue value;
    value.kind = property.kind;
    value.isNull = property.isKey ? !fIsStrict && OneIn(12) : OneIn(5);
    if (value.isNull) {
        return value;
    }
    switch (property.kind) {
    case EKind::kNumber:
        value.number = static_cast<unsigned int>(Below(3));
        break;
    case EKind::kText:
        value.text = OneOf(kTexts);
        break;
    case EKind::kList:
        for (std::size_t count = Below(3); count > 0; --count) {
            value.list.push_back(OneIn(2) ? "x" : "y");
        }
        break;
    case EKind::kPath:
        value.text = "C0";
        if (OneIn(3)) {
            value.list.push_back(OneIn(2) ? "root/other" : "root/third");
        }
        value.pathKeys = {{"Key0", OneIn(2) ? "a" : "b\""}, {"another0", OneIn(2) ? "1" : "2"}};
        break;
    }
    return value;
}

TNaiveElement TGenerator::MakeElement()
{
    TNaiveElement element;
    const TNaiveClass& cls = OneOf(fSchema);
    element.className = cls.name;
    element.def = OneIn(5) ? TNaiveElement::EDefault::kNone
                           : (OneIn(3) ? TNaiveElement::EDefault::kExclude : TNaiveElement::EDefault::kInclude);
    TNaiveNamespace schema;
    schema.classes = fSchema;
    for (const auto& property : AllNaiveProperties(schema, cls.name)) {
        if (property.isKey && OneIn(4)) {
            element.excludedKeys.push_back(property.name);
        }
        if (OneIn(3)) {
            element.listed.emplace_back(property.name, OneIn(2));
        }
    }
    return element;
}

}  // namespace

TNaiveSet MakeRandomSet(std::uint64_t seed, bool isStrict)
{
    std::mt19937_64 random(seed);
    return MakeRandomSet([&random] { return random(); }, isStrict);
}

TNaiveSet MakeRandomSet(const std::function<std::uint64_t()>& source, bool isStrict)
{
    return TGenerator(source, isStrict).Make();
}

}  // namespace NORVZEL20
