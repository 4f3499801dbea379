// Keys in the list of findings. Only one line can be reached with the tabulator; arrows go from line to line.

class Keyboard {
    constructor(findings) {
        this.findings = findings;
        this.list = findings.list;
    }

    press(event) {
        const line = event.target.closest(".line");
        if (!line || event.altKey || event.ctrlKey || event.metaKey) {
            return;
        }
        const { key } = line.closest(".item").dataset;
        const i = this.list.places.get(key);
        const actions = {
            ArrowDown: () => this.goTo(this.next(i, 1)),
            ArrowUp: () => this.goTo(this.next(i, -1)),
            ArrowRight: () => this.open(key),
            ArrowLeft: () => this.close(key),
            Home: () => this.goTo(this.next(-1, 1)),
            End: () => this.goTo(this.next(this.list.items.length, -1)),
        };
        if (actions[event.key]) {
            event.preventDefault();
            actions[event.key]();
        }
    }

    // The next line from `i` on, `i` excluded; -1 if there is none.
    next(i, step) {
        const { items } = this.list;
        for (let at = i + step; at >= 0 && at < items.length; at += step) {
            if (items[at].type === "finding" || items[at].type === "row") {
                return at;
            }
        }
        return -1;
    }

    goTo(i) {
        if (i >= 0) {
            this.list.focus(this.list.items[i].key, coveredAtTop());
        }
    }

    // Opens a closed line; from an open one, goes to the first line in it.
    async open(key) {
        if (!this.findings.isOpen(key)) {
            await this.findings.toggle(key);
            return;
        }
        const { items, places } = this.list;
        const child = this.next(places.get(key), 1);
        if (child >= 0 && items[child].level > items[places.get(key)].level) {
            this.goTo(child);
        }
    }

    // Closes an open line; from a closed one in a finding, goes to the finding.
    async close(key) {
        if (this.findings.isOpen(key)) {
            await this.findings.toggle(key);
            return;
        }
        const { items, places } = this.list;
        const { type, choice } = items[places.get(key)];
        if (type === "row") {
            this.goTo(places.get(`f${choice.finding.first}`));
        }
    }
}

function listenToKeys(root, findings) {
    const keyboard = new Keyboard(findings);
    root.addEventListener("keydown", (event) => keyboard.press(event));
}

// How much of the window the filters cover while they stay at its top.
function coveredAtTop() {
    const filters = byId("filters");
    return getComputedStyle(filters).position === "sticky" ? filters.offsetHeight : 0;
}
