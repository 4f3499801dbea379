"""Groups the differences of a JSON report and compares the result with its `groups`, its counts and the grouped text and Markdown."""

import collections
import json
import re

MOST_EXAMPLES = 8
KINDS = ("onlyInReference", "onlyInOthers", "changed")
HEAD = re.compile(r"(\S+) +((?:-\d+ ?)?(?:\+\d+ ?)?(?:~\d+)?) {3}\S")
HEADING = re.compile(r"### (.*?)((?: -\d+)?(?: \+\d+)?(?: \\~\d+)?)$", re.M)
WHO = re.compile(r"(\d+) {2}(\S.*?)(?= {8}|$)")


def leaves(values):
    """The properties that changed; of embedded instances, the parts."""
    return [leaf for part in values["parts"] for leaf in leaves(part)] if values.get("parts") else [values]


def identity(change):
    """A text that is the same for the same changes. An inventory in which all instances have the value says nothing of its own."""
    groups = []
    for one in change["others"]:
        shares = [share for share in one.get("sharing", []) if share["instances"] > 1]
        groups.append([one["inventories"], one["type"], one["value"], shares])
    return json.dumps([change["reference"]["type"], change["reference"]["value"], groups])


def inventories_of(change, labels):
    named = {label for one in change["others"] for label in one["inventories"]}
    return tuple(label for label in labels if label in named)


class Groups:
    """The differences of a report by what changed and where."""

    def __init__(self, report):
        self.labels = [one["label"] for one in report["inventories"]]
        self.counts = collections.defaultdict(collections.Counter)  # of a class, by kind
        self.changed = collections.defaultdict(set)  # the instances of a class
        self.of_inventories = collections.Counter()
        self.presences = collections.defaultdict(list)  # instances by (class, kind, inventories)
        self.changes = collections.defaultdict(lambda: collections.defaultdict(list))  # by (class, property, inventories) and identity
        for difference in report["differences"]:
            self.add(difference)

    def add(self, difference):
        name, kind = difference["class"], difference["kind"]
        self.counts[name][kind] += 1
        self.of_inventories.update(difference["inventories"])
        if kind != "changed":
            self.presences[name, kind, tuple(difference["inventories"])].append(difference["instance"])
            return
        self.changed[name].add(difference["instance"])
        for leaf in leaves(difference):
            place = (name, leaf["property"], inventories_of(leaf, self.labels))
            self.changes[place][identity(leaf)].append(difference["instance"])


def count_faults(report, groups):
    for one in report["inventories"]:
        if one["differences"] != groups.of_inventories[one["label"]]:
            yield f"groups: {one['label']} has {groups.of_inventories[one['label']]} differences, not {one['differences']}"
    counted = {one["class"]: [one[field] for field in ("onlyInReference", "onlyInOthers", "changedValues", "changedInstances")] for one in report["summary"]["classes"]}
    expected = {name: [*(counts[kind] for kind in KINDS), len(groups.changed[name])] for name, counts in groups.counts.items()}
    if counted != expected or list(counted) != sorted(counted, key=str.lower):
        yield f"groups: the counts of classes are {counted}, not {expected}"


def group_faults(report, groups):
    found = collections.Counter()
    for group in report["groups"]:
        place = (group["class"], group["kind"] if group["kind"] != "changed" else group["property"], tuple(group["inventories"]))
        found[place] += 1
        yield from (f"groups: {place}: {fault}" for fault in (change_faults if group["kind"] == "changed" else presence_faults)(place, group, groups))
    for place in (groups.presences.keys() | groups.changes.keys()) - found.keys():
        yield f"groups: {place} is missing"
    yield from (f"groups: {place} is there {count} times" for place, count in found.items() if count > 1)


def presence_faults(place, group, groups):
    instances = groups.presences.get(place, [])
    if group["instances"] != len(instances) or group["examples"] != instances[:MOST_EXAMPLES]:
        yield f"{group['instances']} instances, {group['examples']}, not {len(instances)}, {instances[:MOST_EXAMPLES]}"


def change_faults(place, group, groups):
    changes = groups.changes.get(place, {})
    if (group["instances"], group["distinctChanges"]) != (sum(map(len, changes.values())), len(changes)):
        yield f"{group['instances']} instances and {group['distinctChanges']} changes, not {sum(map(len, changes.values()))} and {len(changes)}"
    most = sorted(map(len, changes.values()), reverse=True)[:MOST_EXAMPLES]
    if [one["instances"] for one in group["changes"]] != most:
        yield f"changes of {[one['instances'] for one in group['changes']]} instances, not {most}"
    for one in group["changes"]:
        instances = changes.get(identity(one), [])
        if one["instances"] != len(instances) or not set(one["examples"]) <= set(instances):
            yield f"{one} is in the differences for {instances}"
        if len(changes) <= MOST_EXAMPLES and one["examples"] != instances[:MOST_EXAMPLES]:
            yield f"examples are {one['examples']}, not {instances[:MOST_EXAMPLES]}"


# The texts.


def heads(groups):
    """What is said behind the name of each class: -1 +2 ~3."""
    said = {}
    for name, counts in groups.counts.items():
        numbers = [("-", counts["onlyInReference"]), ("+", counts["onlyInOthers"]), ("~", len(groups.changed[name]))]
        said[name] = " ".join(f"{sign}{count}" for sign, count in numbers if count)
    return said


def text_faults(text, report, groups):
    lines, count = text.splitlines(), len(report["differences"])
    if count == 0:
        return
    if f": {count} difference" not in lines[0]:
        yield f"text: the first line is {lines[0]!r}, but JSON has {count} differences"
    if len(groups.labels) == 2:
        yield from pair_faults(lines[0], report, groups)
        return
    shown = {match.group(1): match.group(2) for match in map(HEAD.match, lines) if match}
    if shown != heads(groups):
        yield f"text: classes have {shown}, not {heads(groups)}"
    if sum(int(number) for line in lines[1 : lines.index("")] for number, _ in WHO.findall(line)) < max(groups.of_inventories.values()):
        yield f"text: {lines[1]!r} leaves out the inventory with {max(groups.of_inventories.values())} differences"


def pair_faults(line, report, groups):
    kinds = collections.Counter(one["kind"] for one in report["differences"])
    signs = " ".join(f"{sign}{kinds[kind]}" for sign, kind in (("-", "onlyInReference"), ("+", "onlyInOthers")) if kinds[kind])
    parts = ([signs + " instance" + ("s" if kinds["onlyInReference"] + kinds["onlyInOthers"] > 1 else "")] if signs else []) + (
        [f"{kinds['changed']} value" + ("s" if kinds["changed"] > 1 else "")] if kinds["changed"] else []
    )
    if f"({', '.join(parts)}) in {len(groups.counts)} of " not in line:
        yield f"text: the first line is {line!r}, not ({', '.join(parts)}) in {len(groups.counts)} classes"


def markdown_faults(markdown, text, groups):
    """The same verdict, and a heading with the counts of each class."""
    first = re.sub(r"\\(.)", r"\1", markdown.splitlines()[0].replace("<!-- -->", ""))
    if first != "## " + text.splitlines()[0]:
        yield f"markdown: begins with {first!r}"
    shown = {name.replace("\\", ""): counts.replace("\\", "").strip() for name, counts in HEADING.findall(markdown)}
    if shown != heads(groups):
        yield f"markdown: classes have {shown}, not {heads(groups)}"
    if markdown.count("<details>") != markdown.count("</details>"):
        yield "markdown: what is folded has no end"


def faults(report, text, markdown):
    groups = Groups(report)
    yield from count_faults(report, groups)
    yield from group_faults(report, groups)
    yield from text_faults(text, report, groups)
    yield from markdown_faults(markdown, text, groups)
