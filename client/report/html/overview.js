// The parts of the page that do not change: verdict, counts, the table of classes, inventories, rules and coverage.

// The table begins with so many lines and columns; a button adds the rest. Inventories without differences are shown only if there
// are few.
const kFirstClasses = 24;
const kFirstInventories = 48;
const kFewInventories = 12;

function drawHead(overview) {
    document.title = overview.verdict;
    byId("verdict").textContent = overview.verdict;
    const { counts } = overview;
    const isPair = overview.inventories.length === 2;
    document.documentElement.classList.toggle("pair", isPair);
    const differ = overview.notShown ? "differ in these" : "differ";
    const [reference, other] = overview.inventories.map((inventory) => inventory.label);
    const lines = [
        ["minus", "−", counts.onlyInReference, isPair ? `only in ${reference}` : `in ${reference}, missing elsewhere`],
        ["plus", "+", counts.onlyInOthers, isPair ? `only in ${other}` : "only in others"],
        ["changed", "~", counts.changedValues, counts.changedValues === 1 ? "changed value" : "changed values"],
    ];
    for (const [css, sign, count, text] of lines) {
        byId("counts").append(element("li", {}, element("span", { class: `kind ${css}`, "aria-hidden": "true" }, sign),
            element("strong", {}, formatted(count)), ` ${text}`));
    }
    byId("counts").append(element("li", {}, element("strong", {}, formatted(overview.classes.length)),
        ` of ${counted(overview.comparedClasses, "class", "classes")} ${differ}`));
    if (overview.notShown) {
        byId("counts").append(element("li", { class: "not-shown" }, overview.notShown));
    }
    const differing = overview.inventories.filter((inventory, i) => i !== overview.reference && inventory.differences > 0).length;
    if (!isPair) {
        byId("counts").append(element("li", {}, element("strong", {}, formatted(differing)),
            ` of ${counted(overview.inventories.length - 1, "other inventory", "other inventories")} ${differ}`));
    }
}

class Matrix {
    // `choose({ className, kind, inventory })` is called when a number is clicked.
    constructor(overview, root, choose) {
        this.overview = overview;
        this.root = root;
        this.choose = choose;
        this.mostClasses = kFirstClasses;
        const differing = overview.inventories.filter((inventory) => inventory.differences > 0).length;
        this.mostInventories = overview.inventories.length <= kFewInventories + 1 ? kFewInventories
            : Math.min(kFirstInventories, Math.max(1, differing));
        this.draw();
        root.addEventListener("click", (event) => this.click(event));
        root.addEventListener("keydown", (event) => this.key(event));
    }

    // Those with most differences, in the order of the report.
    largest(list, most, size) {
        const chosen = list.map((value, i) => i).sort((one, other) => size(list[other]) - size(list[one]) || one - other).slice(0, most);
        return chosen.sort((one, other) => one - other);
    }

    draw() {
        const { overview } = this;
        if (overview.classes.length === 0) {
            byId("matrix").hidden = true;
            return;
        }
        const others = overview.inventories.map((inventory, i) => ({ ...inventory, i }))
            .filter((inventory) => inventory.i !== overview.reference || inventory.differences > 0);
        const columns = this.largest(others, this.mostInventories, (inventory) => inventory.differences).map((i) => others[i]);
        const classes = this.largest(overview.classes, this.mostClasses, (cls) => cls.differences).map((i) => overview.classes[i]);
        const head = element("tr", {}, element("th", { scope: "col", class: "corner" }, "Class"));
        kKinds.forEach((kind) => head.append(element("th", { scope: "col", class: "by-kind" },
            element("span", { class: `kind ${kind.css}`, "aria-hidden": "true" }, kind.sign), element("span", { class: "sr" }, kind.name))));
        columns.forEach((inventory) => head.append(element("th", { scope: "col", class: "inventory" }, element("span", {}, inventory.label))));
        const body = element("tbody");
        classes.forEach((cls) => body.append(this.drawClass(cls, columns)));
        const isCrowded = columns.length > 6;
        const table = element("table", { class: isCrowded ? "matrix crowded" : "matrix", role: "grid", "aria-describedby": "matrix-hint" },
            element("caption", { class: "sr" }, "Differences by class, kind and inventory"), element("thead", {}, head), body);
        this.root.replaceChildren(table);
        this.drawMore(classes.length, columns.length, others.length);
        const first = this.root.querySelector("button");
        if (first) {
            first.tabIndex = 0;
        }
    }

    drawMore(classes, columns, others) {
        if (this.more) {
            this.more.remove();
        }
        const missing = [];
        if (classes < this.overview.classes.length) {
            missing.push(counted(this.overview.classes.length - classes, "more class", "more classes"));
        }
        if (columns < others) {
            missing.push(counted(others - columns, "more inventory", "more inventories"));
        }
        this.more = missing.length === 0 ? element("span")
            : element("button", { type: "button", class: "more" }, `Show ${missing.join(" and ")}`);
        this.more.addEventListener("click", () => {
            this.mostClasses = this.mostInventories = Infinity;
            this.draw();
            this.root.querySelector("button").focus();
        });
        this.root.after(this.more);
    }

    drawClass(cls, columns) {
        const line = element("tr", {}, element("th", { scope: "row" },
            element("button", { type: "button", tabindex: "-1", class: "name", "data-class": cls.name,
                "aria-label": `${cls.name}: ${counted(cls.differences, "difference")}` }, cls.name)));
        [cls.onlyInReference, cls.onlyInOthers, cls.changedValues].forEach((count, kind) =>
            line.append(this.drawCount(cls, count, `${kKinds[kind].name}, ${counted(count, "difference")}`, { kind })));
        for (const inventory of columns) {
            const instances = cls.instances[inventory.i];
            const all = Math.max(cls.compared[inventory.i], cls.compared[Math.max(0, this.overview.reference)], instances);
            const percent = Math.max(1, Math.round(100 * instances / all));
            const count = cls.byInventory[inventory.i];
            const cell = this.drawCount(cls, count,
                `${inventory.label}, ${counted(count, "difference")} in ${formatted(instances)} of ${counted(all, "instance")}, ${percent} %`,
                { inventory: inventory.i });
            if (count > 0) {
                cell.classList.add("shaded");
                cell.style.setProperty("--share", `${Math.round(8 + 92 * Math.sqrt(instances / all))}%`);
            }
            line.append(cell);
        }
        return line;
    }

    drawCount(cls, count, label, choice) {
        if (count === 0) {
            return element("td", { class: "none" }, element("span", { "aria-hidden": "true" }, "·"), element("span", { class: "sr" }, "0"));
        }
        return element("td", {}, element("button", { type: "button", tabindex: "-1", title: `${cls.name}, ${label}`, "aria-label": `${cls.name}, ${label}`,
            "aria-pressed": "false", "data-class": cls.name, "data-kind": choice.kind, "data-inventory": choice.inventory }, short(count)));
    }

    click(event) {
        const button = event.target.closest("button");
        if (button) {
            this.activate(button);
            const { inventory, kind } = button.dataset;
            this.choose({ className: button.dataset.class, kind: kind === undefined ? -1 : Number(kind),
                inventory: inventory === undefined ? -1 : Number(inventory) });
        }
    }

    // Arrows go to the next number in their direction.
    key(event) {
        const step = { ArrowUp: [-1, 0], ArrowDown: [1, 0], ArrowLeft: [0, -1], ArrowRight: [0, 1] }[event.key];
        const button = event.target.closest("td button, th button");
        if (!step || !button) {
            return;
        }
        event.preventDefault();
        let cell = button.closest("td, th");
        const table = cell.closest("table");
        do {
            const line = table.rows[cell.parentNode.rowIndex + step[0]];
            cell = line ? line.cells[cell.cellIndex + step[1]] : null;
        } while (cell && !cell.querySelector("button"));
        if (cell) {
            this.activate(cell.querySelector("button"));
            cell.querySelector("button").focus();
        }
    }

    activate(button) {
        this.root.querySelectorAll("button[tabindex='0']").forEach((other) => { other.tabIndex = -1; });
        button.tabIndex = 0;
    }

    // Marks the number that the filters stand for.
    mark(selection) {
        for (const button of this.root.querySelectorAll("td button")) {
            const { kind, inventory } = button.dataset;
            const isChosen = button.dataset.class === selection.className &&
                (kind === undefined ? selection.kinds.size === 0 && selection.inventory === Number(inventory)
                    : selection.kinds.size === 1 && selection.kinds.has(Number(kind)) && selection.inventory < 0);
            button.setAttribute("aria-pressed", String(isChosen));
        }
    }
}

// 1234 as 1.2k: columns are narrow.
function short(number) {
    if (number < 1000) {
        return String(number);
    }
    const [unit, sign] = number < 999500 ? [1000, "k"] : [1000000, "M"];
    return (number / unit < 9.95 ? (number / unit).toFixed(1) : Math.round(number / unit)) + sign;
}

function drawInventories(overview) {
    const most = Math.max(1, ...overview.inventories.map((inventory) => inventory.differences));
    const body = element("tbody");
    overview.inventories.forEach((inventory, i) => {
        const isReference = i === overview.reference;
        const bar = element("span", { class: "bar", "aria-hidden": "true" });
        bar.style.setProperty("--part", `${100 * inventory.differences / most}%`);
        body.append(element("tr", {}, element("th", { scope: "row" }, inventory.label, isReference ? element("span", { class: "tag" }, "reference") : null),
            element("td", { class: "number" }, isReference && inventory.differences === 0 ? "–" : formatted(inventory.differences)),
            element("td", { class: "bar-cell" }, bar),
            element("td", { class: "number" }, formatted(inventory.instances)),
            element("td", { class: "value" }, inventory.namespace), element("td", { class: "value file" }, inventory.file)));
    });
    byId("inventories-table").replaceChildren(element("table", { class: "plain" },
        element("caption", { class: "sr" }, "Inventories"),
        element("thead", {}, element("tr", {}, ...["Inventory", "Differences", "", "Instances compared", "Namespace", "File"].map((name, i) =>
            name ? element("th", { scope: "col", class: i === 1 || i === 3 ? "number" : null }, name) : element("td")))), body));
}

function drawRules(overview) {
    const { rules } = overview;
    const root = byId("rules-text");
    const said = element("p");
    if (rules.isMade) {
        said.append(rules.options ? "No rules file was given." : "No rules were given: everything was compared.");
    } else {
        said.append("Compared as ", element("span", { class: "value" }, rules.name), " says.");
    }
    if (rules.options) {
        said.append(" Options narrowed what was compared: ", element("span", { class: "value" }, rules.options), ".");
    }
    root.append(said, element("p", {}, "SHA-256 of the rules: ", element("code", { id: "digest" }, rules.digest)));
    if (rules.text) {
        root.append(element("details", {}, element("summary", {}, "The rules"),
            element("pre", { tabindex: "0", role: "region", "aria-label": "Text of the rules" }, rules.text)));
    }
}

// What a baseline accepts, if there is one.
function drawBaseline(overview) {
    byId("baseline").hidden = overview.baseline.length === 0;
    byId("baseline-text").textContent = overview.baseline.join("\n");
}

function drawCoverage(overview) {
    for (const line of overview.coverage) {
        byId("coverage-text").append(element("li", {}, line));
    }
}
