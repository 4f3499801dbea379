#include "tests/engine/RandomSet.h"

#include <algorithm>
#include <map>
#include <random>

#include "tests/engine/NaiveRules.h"
#include "tests/engine/NaiveText.h"

namespace NORVZEL20 {

namespace {

using EKind = TNaiveValue::EKind;

// The texts of the kinds that one text says. Some are equal by value and written in different ways.
const std::map<EKind, std::vector<std::string>> kTexts = {
    {EKind::kBoolean, {"TRUE", "FALSE"}},
    {EKind::kUint8, {"0", "255"}},
    {EKind::kSint8, {"-128", "0", "127"}},
    {EKind::kUint16, {"0", "65535"}},
    {EKind::kSint16, {"-32768", "0"}},
    {EKind::kUint32, {"0", "1", "2"}},
    {EKind::kSint32, {"-2147483648", "1"}},
    {EKind::kUint64, {"0", "18446744073709551615"}},
    {EKind::kSint64, {"-9223372036854775808", "1"}},
    {EKind::kReal32, {"0", "-0", "0.1", "NaN"}},
    {EKind::kReal64, {"0", "-0", "0.1", "1e+300", "NaN", "INF", "-INF"}},
    {EKind::kChar, {"x", "X", "'", "\\"}},
    {EKind::kText, {"a", "b", "a\",another0=1", "\\", ""}},
    {EKind::kTime,
     {"20240229120000.000000+060", "20240229110000.000000+000", "20240229120000.000000+000", "20240301003000.000000+810",
      "2024022912****.******+060", "2024022911****.******+000", "2024022912****.******+090", "2024022911****.******+030",
      "20240229******.******+060", "20240229******.******+000", "00000001000000.000000:000", "000000010000**.******:000"}},
};

// The kinds that a key may have.
const std::vector<EKind> kKinds = {EKind::kBoolean, EKind::kUint8,  EKind::kSint8,  EKind::kUint16, EKind::kSint16, EKind::kUint32,
                                   EKind::kSint32,  EKind::kUint64, EKind::kSint64, EKind::kReal32, EKind::kReal64, EKind::kChar,
                                   EKind::kText,    EKind::kTime,   EKind::kPath,   EKind::kObject};

TNaiveValue Simple(EKind kind, const std::string& text)
{
    return {kind, false, text, {}, {}};
}

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
    void FillPath(TNaiveValue& value);
    void FillObject(TNaiveValue& value);
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
    fSchema.push_back({"KALMO_OperatingSystem", "", {{"Name", EKind::kText, true}, {"OSType", EKind::kUint32, false}}});
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
        cls.properties = {{"Key" + suffix, EKind::kText, true}, {"another" + suffix, EKind::kUint32, true}};
        if (OneIn(2)) {
            cls.properties.push_back({"third" + suffix, OneOf(kKinds), true});
        }
    }
    const std::vector<TNaiveProperty> choices = {{"Size" + suffix, EKind::kUint32, false},
                                                 {"Label" + suffix, EKind::kText, false},
                                                 {"Tags" + suffix, EKind::kList, false},
                                                 {"Owner" + suffix, EKind::kPath, false},
                                                 {"Any" + suffix, OneOf(kKinds), false}};
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
        system.values["OSType"] = Simple(EKind::kUint32, "36");
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
            if (property.isKey && NaiveKeyText(mine) != NaiveKeyText(theirs)) {
                return false;
            }
        }
        return true;
    });
}

TNaiveValue TGenerator::MakeValue(const TNaiveProperty& property)
{
    TNaiveValue value;
    value.kind = property.kind;
    // The plain host numbers a uint64 key that is null.
    value.isNull = property.isKey ? !fIsStrict && property.kind != EKind::kUint64 && OneIn(12) : OneIn(5);
    if (value.isNull) {
        return value;
    }
    switch (property.kind) {
    case EKind::kList:
        for (std::size_t count = Below(3); count > 0; --count) {
            value.list.push_back(OneIn(2) ? "x" : "y");
        }
        break;
    case EKind::kPath:
        FillPath(value);
        break;
    case EKind::kObject:
        FillObject(value);
        break;
    default:
        value.text = OneOf(kTexts.at(property.kind));
        break;
    }
    return value;
}

void TGenerator::FillPath(TNaiveValue& value)
{
    static const std::vector<std::string> kNamespaces = {"root/other", "ROOT/Other", "root/third"};
    value.text = "C0";
    if (OneIn(3)) {
        value.list.push_back(OneOf(kNamespaces));
    }
    value.members = {{"Key0", Simple(EKind::kText, OneIn(2) ? "a" : "b\"")},
                     {"another0", Simple(EKind::kText, OneIn(2) ? "1" : "2")}};
    if (OneIn(3)) {
        value.members.push_back({"third0", Simple(EKind::kTime, OneOf(kTexts.at(EKind::kTime)))});
    }
}

// Equal objects in different orders and spellings, and a few that differ.
void TGenerator::FillObject(TNaiveValue& value)
{
    value.text = OneIn(2) ? "Setting" : "SETTING";
    value.members = {{OneIn(2) ? "Size" : "SIZE", Simple(EKind::kUint32, OneIn(2) ? "1" : "2")},
                     {OneIn(2) ? "Name" : "name", Simple(EKind::kText, OneIn(3) ? "a<\"&" : "b")},
                     {"At", Simple(EKind::kTime, OneOf(kTexts.at(EKind::kTime)))},
                     {"Load", Simple(EKind::kReal32, OneIn(2) ? "0" : "-0")}};
    value.members[3].value.isNull = OneIn(3);
    if (OneIn(2)) {
        std::swap(value.members[0], value.members[1]);
    }
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
