// Documents that expand to far more than their size: entities of entities, long entities used often, entities without end.
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/HostileRow.h"

namespace NORVZEL20 {

namespace {

/// Ten entities, each of ten of the one before: ten thousand million letters.
THostileDocument BillionLaughs(const std::string& content)
{
    std::string prolog = "<!DOCTYPE r [<!ENTITY e0 \"0123456789\">";
    for (int level = 1; level < 10; ++level) {
        prolog += "<!ENTITY e" + std::to_string(level) + " \"" + Repeat("&e" + std::to_string(level - 1) + ";", 10) + "\">";
    }
    return {prolog + "]>", content};
}

/// One long entity, for contents that use it often.
THostileDocument QuadraticBlowUp(const std::string& content)
{
    return {"<!DOCTYPE r [<!ENTITY e \"" + std::string(kMegabyte / 4, 'x') + "\">]>", content};
}

const std::string kReferences = Repeat("&e;", 1000);

/// Parameter entities expand in the declarations.
THostileDocument ParameterBomb()
{
    std::string prolog = "<!DOCTYPE r [<!ENTITY % p0 \"<!-- 0123456789 -->\">";
    for (int level = 1; level < 10; ++level) {
        prolog += "<!ENTITY % p" + std::to_string(level) + " \"" + Repeat("&#37;p" + std::to_string(level - 1) + ";", 10) + "\">";
    }
    return {prolog + "%p9;]>", "Id"};
}

THostileDocument ManyEntities()
{
    std::string prolog = "<!DOCTYPE r [";
    for (int i = 0; i < 1001; ++i) {
        prolog += "<!ENTITY e" + std::to_string(i) + " \"v\">";
    }
    return {prolog + "]>", "Id"};
}

}  // namespace

TEST(EntityTest, BombsAreRefused)
{
    const std::string reason = "limit on input amplification factor (from DTD and entities) breached";
    ExpectOutcomes({
        Within(16 * kMegabyte, Refused("billion laughs in text", BillionLaughs("&e9;"), 0, reason)),
        Within(16 * kMegabyte, Refused("one long entity often", QuadraticBlowUp(kReferences), 19 * 3, reason)),
        Refused("an entity of itself", {"<!DOCTYPE r [<!ENTITY e \"&f;\"><!ENTITY f \"&e;\">]>", "&e;"}, 0,
                "recursive entity reference"),
        RefusedAt("too many declarations", ManyEntities(), 17919, "too many entity declarations"),
        Refused("an undeclared entity", {"", "&nobody;"}, 0, "undefined entity"),
    });
}

/// The library puts an attribute's value together before it reports the element.
TEST(EntityTest, BombsInAttributesAreRefused)
{
    const std::string reason = "limit on input amplification factor (from DTD and entities) breached";
    const std::string recursive = "<!DOCTYPE r [<!ENTITY e \"&f;\"><!ENTITY f \"&e;\">]>";
    ExpectOutcomes({
        Within(16 * kMegabyte, Refused("billion laughs", BillionLaughs("<a b='&e9;'/>"), 0, reason)),
        Within(16 * kMegabyte, Refused("one long entity often", QuadraticBlowUp("<a b='" + kReferences + "'/>"), 0, reason)),
        Refused("an entity of itself", {recursive, "<a b='&e;'/>"}, 0, "recursive entity reference"),
        Refused("an undeclared entity", {"", "<a b='&nobody;'/>"}, 0, "undefined entity"),
    });
}

/// Parameter entities are not expanded at all.
TEST(EntityTest, ParameterBombsAreNotLit)
{
    ExpectOutcomes({Handled("parameter entities", ParameterBomb())});
}

/// The limits must not hit what honest writers use.
TEST(EntityTest, ModestEntitiesAreReplaced)
{
    ExpectOutcomes({Handled("an entity", {"<!DOCTYPE r [<!ENTITY i \"I&#100;\">]>", "&i;"}),
                    Handled("character references", {"", "&#73;&#x64;"})});
}

}  // namespace NORVZEL20
