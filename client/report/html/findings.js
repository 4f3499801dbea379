// The list of findings: a line for each, which opens to the instances, and an instance to its table of values.

const kKinds = [
    { sign: "−", name: "missing elsewhere", css: "minus" },
    { sign: "+", name: "only elsewhere", css: "plus" },
    { sign: "~", name: "changed", css: "changed" },
];

class Findings {
    constructor(overview, root, whenRows) {
        this.overview = overview;
        this.whenRows = whenRows;
        this.openFindings = new Set();
        this.openRows = new Set();
        this.openRules = new Set();
        this.selected = [];
        this.query = "";
        this.list = new WindowedList(root, (item) => this.draw(item));
        root.addEventListener("click", (event) => this.click(event));
        root.addEventListener("focusin", (event) => this.follow(event));
    }

    setRows(rows) {
        this.rows = rows;
        this.tables = new ValueTables(this.overview, rows);
    }

    // What the filters selected, in its order; see Selection.select.
    show(selected, query) {
        this.selected = selected;
        this.query = query;
        this.update(false);
    }

    update(keeps) {
        const items = [];
        for (const choice of this.selected) {
            this.addItems(items, choice);
        }
        this.list.setItems(items, keeps);
    }

    addItems(items, choice) {
        const number = choice.finding.first;
        items.push({ key: `f${number}`, type: "finding", level: 1, choice });
        if (!this.openFindings.has(number)) {
            return;
        }
        items.push({ key: `t${number}`, type: "tools", level: 2, choice });
        for (let i = 0; i < choice.count; ++i) {
            const row = choice.rows ? choice.rows[i] : number + i;
            items.push({ key: `r${row}`, type: "row", level: 2, choice, row });
            if (this.openRows.has(row)) {
                items.push({ key: `v${row}`, type: "values", level: 3, choice, row });
            }
        }
    }

    draw(item) {
        switch (item.type) {
        case "finding":
            return this.drawFinding(item.choice);
        case "tools":
            return this.drawTools(item.choice);
        case "row":
            return this.drawRow(item.choice.finding, item.row);
        default:
            return element("div", { class: "item values-item" }, this.tables.draw(item.choice.finding, item.row));
        }
    }

    drawFinding(choice) {
        const { finding } = choice;
        const kind = kKinds[finding.kind];
        const isOpen = this.openFindings.has(finding.first);
        const name = element("span", { class: "name" }, element("span", { class: "class" },
            marked(this.overview.classes[finding.class].name, this.query)));
        if (finding.kind === kChanged) {
            name.append(element("span", { class: "dot" }, "."), element("span", { class: "property" }, marked(finding.property, this.query)));
        }
        const button = element("button", { type: "button", class: "line", "aria-expanded": String(isOpen) },
            element("span", { class: "mark", "aria-hidden": "true" }),
            element("span", { class: `kind ${kind.css}` }, element("span", { "aria-hidden": "true" }, kind.sign),
                element("span", { class: "sr" }, `${kind.name}: `)),
            name, this.summaryOf(choice),
            element("span", { class: "who" }, whoText(this.overview, finding.kind, finding.set)),
            element("span", { class: "count" }, formatted(choice.count),
                element("span", { class: "of" }, choice.count < finding.rows ? ` of ${formatted(finding.rows)}` : ""),
                element("span", { class: "sr" }, choice.count === 1 ? " instance" : " instances")));
        return element("div", { class: "item finding" }, element("h3", {}, button));
    }

    summaryOf(choice) {
        const { finding } = choice;
        const example = choice.rows ? this.exampleOf(choice) : this.givenExample(finding);
        const summary = element("span", { class: "summary" });
        const names = element("span", { class: "names" }, marked(example.names.join(", "), this.query));
        const more = choice.count > example.names.length ? ` … ${formatted(choice.count - example.names.length)} more` : "";
        if (finding.kind !== kChanged) {
            summary.append(names, more, choice.count === 1 ? contentNodes(example.contents, this.query) : "");
        } else if (choice.count === 1) {
            summary.append(names, ": ", changeNodes(this.overview, example.change, this.query));
        } else if (finding.changes === 1) {
            summary.append(changeNodes(this.overview, example.change, this.query), names, more);
        } else {
            summary.append(element("span", { class: "label" }, `${counted(finding.changes, "distinct change")}, as `),
                marked(example.names[0], this.query), ": ", changeNodes(this.overview, example.change, this.query));
        }
        return summary;
    }

    givenExample(finding) {
        const { names, contents, reference, others, short } = finding.example;
        return { names, contents, change: { reference, short, groups: others.map(([value, set]) => ({ value, set })) } };
    }

    exampleOf(choice) {
        const rows = this.rows;
        const names = [...choice.rows.subarray(0, 12)].map((row) => cut(rows.text(rows.instanceName[rows.rowInstance[row]]), 80));
        const content = rows.rowContent[choice.rows[0]];
        return choice.finding.kind === kChanged ? { names, change: rows.change(content) } : { names, contents: rows.contents(content) };
    }

    drawTools(choice) {
        const { finding } = choice;
        const isOpen = this.openRules.has(finding.first);
        const facts = [`${counted(choice.count, "instance")} of ${this.overview.classes[finding.class].name}`];
        if (finding.kind === kChanged) {
            facts.push(counted(finding.changes, "distinct change"));
        }
        const who = whoText(this.overview, finding.kind, finding.set);
        if (who) {
            facts.push(who);
        }
        const tools = element("div", { class: "tools" }, element("p", {}, facts.join(" · ")),
            element("button", { type: "button", class: "rule-button", "aria-expanded": String(isOpen), "data-finding": finding.first },
                "Rule to leave this out"));
        return element("div", { class: "item tools-item" }, tools, isOpen ? this.drawRule(finding.rule) : null);
    }

    drawRule(rule) {
        return element("div", { class: "rule" }, element("p", {}, `${rule.what} ${rule.place}`),
            element("pre", { tabindex: "0", "aria-label": "Rule" }, rule.xml),
            element("button", { type: "button", class: "copy" }, "Copy rule"));
    }

    drawRow(finding, row) {
        const rows = this.rows;
        const name = rows.text(rows.instanceName[rows.rowInstance[row]]);
        const content = rows.rowContent[row];
        const said = finding.kind === kChanged ? changeNodes(this.overview, rows.change(content), this.query)
            : contentNodes(rows.contents(content), this.query);
        return element("div", { class: "item row" },
            element("button", { type: "button", class: "line", "aria-expanded": String(this.openRows.has(row)) },
                element("span", { class: "mark", "aria-hidden": "true" }),
                element("span", { class: "name" }, marked(cut(name), this.query)), said));
    }

    click(event) {
        const button = event.target.closest("button");
        if (!button) {
            return;
        }
        if (button.classList.contains("line")) {
            this.toggle(button.closest(".item").dataset.key);
        } else if (button.classList.contains("rule-button")) {
            this.toggleRule(button);
        } else if (button.classList.contains("copy")) {
            copyRule(button);
        }
    }

    itemOf(key) {
        return this.list.items[this.list.places.get(key)];
    }

    isOpen(key) {
        const item = this.itemOf(key);
        return item.type === "finding" ? this.openFindings.has(item.choice.finding.first) : this.openRows.has(item.row);
    }

    async toggle(key) {
        await this.whenRows;
        const item = this.itemOf(key);
        if (!item) {
            return;
        }
        const open = item.type === "finding" ? this.openFindings : this.openRows;
        const number = item.type === "finding" ? item.choice.finding.first : item.row;
        if (!open.delete(number)) {
            open.add(number);
            // An only instance is opened with its finding.
            if (item.type === "finding" && item.choice.count === 1) {
                this.openRows.add(item.choice.rows ? item.choice.rows[0] : number);
            }
        }
        this.list.setActive(key);
        const drawn = this.list.elements.get(key);
        if (drawn) {
            drawn.querySelector(".line").setAttribute("aria-expanded", String(open.has(number)));
        }
        this.update(true);
    }

    // The button is drawn anew, so the focus goes to the new one.
    toggleRule(button) {
        const number = Number(button.dataset.finding);
        if (!this.openRules.delete(number)) {
            this.openRules.add(number);
        }
        const key = `t${number}`;
        this.list.elements.get(key).remove();
        this.list.elements.delete(key);
        this.list.render();
        this.list.elements.get(key).querySelector(".rule-button").focus();
    }

    follow(event) {
        const line = event.target.closest(".line");
        if (line) {
            this.list.setActive(line.closest(".item").dataset.key);
        }
    }
}

async function copyRule(button) {
    const text = button.parentNode.querySelector("pre").textContent;
    let isCopied = false;
    try {
        await navigator.clipboard.writeText(text);
        isCopied = true;
    } catch (error) {
        isCopied = copySelected(button.parentNode.querySelector("pre"));
    }
    button.textContent = isCopied ? "Copied" : "Select the text and copy it";
    byId("said").textContent = (isCopied ? "The rule is copied." : "The rule cannot be copied here; select the text and copy it.");
}

// Browsers give a page from a file no clipboard, but they copy what is selected.
function copySelected(node) {
    const selection = getSelection();
    selection.selectAllChildren(node);
    return document.execCommand("copy");
}
