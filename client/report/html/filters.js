// Search and filters, and what of the findings they leave.

function announce(text) {
    byId("result").textContent = text;
}

class Filters {
    constructor(overview, selection, changed) {
        this.overview = overview;
        this.selection = selection;
        this.changed = changed;
        this.drawKinds();
        this.fill("class", "All classes", overview.classes.map((cls) => [cls.name, cls.name]));
        this.fillProperties();
        this.fill("inventory", "All inventories", overview.inventories.map((inventory, i) => [String(i), inventory.label])
            .filter(([i]) => Number(i) !== overview.reference || overview.inventories[i].differences > 0));
        byId("filters").addEventListener("submit", (event) => event.preventDefault());
        byId("search").addEventListener("input", () => this.later());
        byId("class").addEventListener("change", () => this.chooseClass());
        byId("property").addEventListener("change", () => this.read());
        byId("inventory").addEventListener("change", () => this.read());
        byId("order").addEventListener("change", () => this.read());
        byId("clear").addEventListener("click", () => this.clear());
    }

    drawKinds() {
        const { counts } = this.overview;
        [counts.onlyInReference, counts.onlyInOthers, counts.changedValues].forEach((count, kind) => {
            const button = element("button", { type: "button", "aria-pressed": "false", "data-kind": kind, title: kKinds[kind].name },
                element("span", { class: `kind ${kKinds[kind].css}`, "aria-hidden": "true" }, kKinds[kind].sign),
                element("span", { class: "sr" }, kKinds[kind].name + " "), formatted(count));
            button.disabled = count === 0;
            button.addEventListener("click", () => {
                button.setAttribute("aria-pressed", String(button.getAttribute("aria-pressed") !== "true"));
                this.read();
            });
            byId("kinds").append(button);
        });
    }

    fill(id, all, choices) {
        byId(id).replaceChildren(element("option", { value: id === "inventory" ? "-1" : "" }, all),
            ...choices.map(([value, text]) => element("option", { value }, text)));
    }

    // The properties of the chosen class, or of all.
    fillProperties() {
        const { className } = this.selection;
        const names = new Set(this.overview.findings
            .filter((finding) => finding.kind === kChanged && (!className || this.overview.classes[finding.class].name === className))
            .map((finding) => finding.property));
        this.fill("property", "All properties", [...names].sort().map((name) => [name, name]));
        if (!names.has(this.selection.property)) {
            this.selection.property = "";
        }
        byId("property").value = this.selection.property;
    }

    chooseClass() {
        this.selection.className = byId("class").value;
        this.fillProperties();
        this.read();
    }

    later() {
        clearTimeout(this.timer);
        this.timer = setTimeout(() => this.read(), 150);
    }

    read() {
        const { selection } = this;
        selection.query = lowered(byId("search").value.trim());
        selection.className = byId("class").value;
        selection.property = byId("property").value;
        selection.inventory = Number(byId("inventory").value);
        selection.kinds = new Set([...byId("kinds").querySelectorAll("[aria-pressed='true']")].map((button) => Number(button.dataset.kind)));
        this.changed();
    }

    // Sets what a number of the table of classes stands for; the same number again clears it.
    choose({ className, kind, inventory }) {
        const { selection } = this;
        const isSame = selection.className === className && selection.inventory === inventory && selection.property === "" &&
            (kind < 0 ? selection.kinds.size === 0 : selection.kinds.size === 1 && selection.kinds.has(kind));
        selection.clear();
        if (!isSame) {
            selection.className = className;
            selection.inventory = inventory;
            selection.kinds = new Set(kind < 0 ? [] : [kind]);
        }
        this.write();
    }

    clear() {
        this.selection.clear();
        this.write();
        byId("search").focus();
    }

    write() {
        const { selection } = this;
        byId("search").value = selection.query;
        byId("class").value = selection.className;
        this.fillProperties();
        byId("inventory").value = String(selection.inventory);
        for (const button of byId("kinds").children) {
            button.setAttribute("aria-pressed", String(selection.kinds.has(Number(button.dataset.kind))));
        }
        this.changed();
    }

    // How much there is, for the eye and for screen readers.
    sayResult(selected, differences) {
        const { counts, findings } = this.overview;
        byId("clear").disabled = !this.selection.isActive();
        if (!this.selection.isActive()) {
            announce(`${counted(counts.differences, "difference")} in ${counted(findings.length, "finding")}`);
        } else if (selected.length === 0) {
            announce(`None of ${counted(counts.differences, "difference")} matches the filters.`);
        } else {
            announce(`${formatted(differences)} of ${counted(counts.differences, "difference")} in ${counted(selected.length, "finding")}`);
        }
    }
}
