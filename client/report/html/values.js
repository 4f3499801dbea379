// Tables of values: a row for each distinct value, a column for each inventory, a dot where the inventory has the value.

class ValueTables {
    constructor(overview, rows) {
        this.overview = overview;
        this.rows = rows;
    }

    // Everything about one row of a finding.
    draw(finding, row) {
        const rows = this.rows;
        const instance = rows.instance(rows.rowInstance[row]);
        const content = rows.rowContent[row];
        const panel = element("div", { class: "panel" }, this.drawInstance(finding, instance));
        if (finding.kind === kChanged) {
            panel.append(this.drawChange(finding.property, rows.change(content), instance));
            return panel;
        }
        const set = rows.rowSet[row];
        panel.append(this.drawPresence(finding.kind, set));
        for (const { property, change } of rows.disagreements(content)) {
            panel.append(this.drawDisagreement(property, change, set));
        }
        panel.append(this.drawContents(finding, set, rows.contents(content)));
        return panel;
    }

    drawInstance(finding, instance) {
        const lines = element("dl", { class: "facts" });
        const add = (name, value) => lines.append(element("div", {}, element("dt", {}, name), element("dd", { class: "value" }, value)));
        add("Instance", `${this.overview.classes[finding.class].name}${instance.key ? "." + instance.key : ""}`);
        if (instance.path) {
            add("Path", instance.path);
        }
        const sharing = [...instance.sharing].map((count, i) => [count, i]).filter(([count]) => count > 1);
        if (sharing.length > 0) {
            add("Shared key", sharing.map(([count, i]) => `${counted(count, "instance")} of ${this.overview.inventories[i].label}`).join(", "));
        }
        return lines;
    }

    drawChange(property, change, instance) {
        const all = this.overview.inventories.length;
        const lacking = new Set(this.overview.sets[instance.lacking].inventories);
        const others = change.groups.map((group) => this.holders(group));
        const reference = new Map();
        for (let i = 0; i < all; ++i) {
            const differing = others.reduce((sum, holders) => sum + (holders.get(i) || 0), 0);
            const instances = Math.max(1, instance.sharing[i] || 1);
            if (!lacking.has(i) && differing < instances) {
                reference.set(i, instances - differing);
            }
        }
        const lines = [{ text: change.reference, holders: reference, kind: "old" },
            ...change.groups.map((group, i) => ({ text: group.value, holders: others[i], kind: "new" }))];
        if (lacking.size > 0) {
            lines.push({ text: "missing", holders: new Map([...lacking].map((i) => [i, 1])), kind: "missing" });
        }
        return this.drawTable(property, lines);
    }

    drawDisagreement(property, change, set) {
        const present = new Set(this.overview.sets[set].inventories);
        const lines = change.groups.map((group) => ({ text: group.value, holders: this.holders(group), kind: "new" }));
        lines.push({ text: "missing", holders: this.allBut(present), kind: "missing" });
        return this.drawTable(property, lines);
    }

    drawPresence(kind, set) {
        const inventories = new Set(this.overview.sets[set].inventories);
        const named = new Map([...inventories].map((i) => [i, 1]));
        const rest = this.allBut(inventories);
        return this.drawTable("Instance", [
            { text: "present", holders: kind === kOnlyInReference ? rest : named, kind: "present" },
            { text: "missing", holders: kind === kOnlyInReference ? named : rest, kind: "missing" }]);
    }

    drawContents(finding, set, pairs) {
        if (pairs.length === 0) {
            return element("p", { class: "hint" }, "No property beside its keys has a value.");
        }
        const holder = finding.kind === kOnlyInReference ? this.overview.reference : this.overview.sets[set].inventories[0];
        const body = element("tbody");
        for (const [property, value] of pairs) {
            body.append(element("tr", {}, element("th", { scope: "row" }, property), element("td", { class: "value long" }, value)));
        }
        return this.scrolling(element("table", { class: "values contents-table" },
            element("caption", {}, `What it holds in ${this.overview.inventories[holder].label}`),
            element("thead", {}, element("tr", {}, element("th", { scope: "col" }, "Property"), element("th", { scope: "col" }, "Value"))),
            body));
    }

    holders(group) {
        const inventories = this.overview.sets[group.set].inventories;
        return new Map(inventories.map((inventory, i) => [inventory, group.counts[i] || 1]));
    }

    allBut(inventories) {
        const rest = new Map();
        this.overview.inventories.forEach((_, i) => {
            if (!inventories.has(i)) {
                rest.set(i, 1);
            }
        });
        return rest;
    }

    // `lines` are { text, holders: inventory -> how many of its instances, kind }.
    drawTable(title, lines) {
        const inventories = this.overview.inventories;
        const head = element("tr", {}, element("th", { scope: "col", class: "corner" }, title));
        inventories.forEach((inventory, i) => {
            const isReference = i === this.overview.reference;
            head.append(element("th", { scope: "col", class: isReference ? "inventory reference" : "inventory" },
                element("span", {}, inventory.label), isReference ? element("span", { class: "sr" }, " (reference)") : null));
        });
        const body = element("tbody");
        for (const { text, holders, kind } of lines) {
            if (holders.size === 0) {
                continue;
            }
            const line = element("tr", { class: kind }, element("th", { scope: "row" },
                element("span", { class: "value long" }, text), element("span", { class: "share" }, ` ${holders.size} of ${inventories.length}`)));
            inventories.forEach((_, i) => line.append(this.drawCell(holders.get(i) || 0)));
            body.append(line);
        }
        const isCrowded = inventories.length > 6;
        return this.scrolling(element("table", { class: isCrowded ? "values crowded" : "values" },
            element("caption", { class: "sr" }, `Values of ${title} by inventory`), element("thead", {}, head), body));
    }

    drawCell(count) {
        if (count === 0) {
            return element("td");
        }
        return count > 1 ? element("td", { class: "has" }, formatted(count))
            : element("td", { class: "has" }, element("span", { "aria-hidden": "true" }, "●"), element("span", { class: "sr" }, "yes"));
    }

    scrolling(table) {
        return element("div", { class: "wide", tabindex: "0", role: "region", "aria-label": table.querySelector("caption").textContent }, table);
    }
}
