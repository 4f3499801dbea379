// How a change is said in a line: what was, an arrow, what is.

function setText(overview, set) {
    return overview.sets[set].text;
}

// Which inventories a finding is about. Of two, a change concerns both.
function whoText(overview, kind, set) {
    const isPair = overview.inventories.length === 2;
    if (kind === kChanged) {
        return isPair ? "" : setText(overview, set);
    }
    if (isPair) {
        return `only in ${overview.inventories[kind === kOnlyInReference ? overview.reference : overview.sets[set].inventories[0]].label}`;
    }
    return `${kind === kOnlyInReference ? "missing in" : "only in"} ${setText(overview, set)}`;
}

// `change` is { reference, short, groups: [{ value, set }] }.
function changeNodes(overview, change, query) {
    const line = element("span", { class: "change" });
    const names = (set) => overview.inventories.length > 2 && change.groups.length > 1
        ? element("span", { class: "who" }, ` ${setText(overview, set)}`) : null;
    if (change.short && change.groups.length === 1) {
        line.append(...shortNodes(cut(change.short), query));
        return line;
    }
    line.append(valueNode("old", change.reference, query), element("span", { class: "arrow" }, " → "));
    change.groups.slice(0, 12).forEach((group, i) => {
        line.append(i > 0 ? element("span", { class: "between" }, " / ") : "", valueNode("new", group.value, query));
        const who = names(group.set);
        if (who) {
            line.append(who);
        }
    });
    if (change.groups.length > 12) {
        line.append(` … ${formatted(change.groups.length - 12)} more values`);
    }
    return line;
}

function valueNode(kind, value, query) {
    return element("span", { class: `value ${kind}` }, marked(cut(value), query));
}

// The short text of a change, "-noexec +nodev" or one cut around what differs.
function shortNodes(text, query) {
    const arrow = text.indexOf(" -> ");
    if (arrow >= 0) {
        return [valueNode("old", text.slice(0, arrow), query), element("span", { class: "arrow" }, " → "),
            valueNode("new", text.slice(arrow + 4), query)];
    }
    return [valueNode("some", text, query)];
}

// What an instance that came or went holds.
function contentNodes(pairs, query, most = 6) {
    const line = element("span", { class: "contents" });
    pairs.slice(0, most).forEach(([property, value], i) => {
        line.append(i > 0 ? ", " : "", element("span", { class: "property" }, marked(property, query)), " ",
            element("span", { class: "value" }, marked(cut(value, 120), query)));
    });
    if (pairs.length > most) {
        line.append(`, … ${formatted(pairs.length - most)} more`);
    }
    return line;
}
