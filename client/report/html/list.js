// A list of lines; only those in the window are in the document. Lines have keys; an element stays as long as its line is in
// view. Heights are measured when a line is drawn; until then a line is as high as the last one of its type that was measured.
//
// Browsers limit the height of an element. A longer list is drawn in one of the greatest height, and scrolls faster.

const kGreatestHeight = 12000000;
const kBeyondView = 400;
// All lines of such a type are of one height.
const kAlikeTypes = new Set(["finding", "row"]);

class WindowedList {
    // `draw(item)` makes the element of an item { key, type, level }.
    constructor(root, draw) {
        this.root = root;
        this.draw = draw;
        this.items = [];
        this.measured = new Uint8Array(0);
        this.elements = new Map();
        this.usual = { finding: 36, row: 30, tools: 44, values: 160 };
        this.activeKey = "";
        this.isPrinting = false;
        window.addEventListener("scroll", () => this.schedule(), { passive: true });
        new ResizeObserver(() => this.resize()).observe(root);
    }

    // Other widths make other heights.
    resize() {
        if (this.root.clientWidth !== this.width) {
            this.width = this.root.clientWidth;
            this.measured.fill(0);
            this.schedule();
        }
    }

    schedule() {
        if (!this.isScheduled) {
            this.isScheduled = true;
            requestAnimationFrame(() => {
                this.isScheduled = false;
                this.render();
            });
        }
    }

    // Elements of lines that stay are kept if `keeps`; their contents must be the same then.
    setItems(items, keeps) {
        if (!keeps) {
            for (const made of this.elements.values()) {
                made.remove();
            }
            this.elements.clear();
        }
        const heights = new Map();
        if (keeps) {
            this.items.forEach((item, i) => this.measured[i] && heights.set(item.key, this.heights[i]));
        }
        this.items = items;
        this.measured = Uint8Array.from(items, (item) => (heights.has(item.key) ? 1 : 0));
        this.heights = Float64Array.from(items, (item) => heights.get(item.key) || this.usual[item.type]);
        this.places = new Map(items.map((item, i) => [item.key, i]));
        if (!this.places.has(this.activeKey)) {
            this.activeKey = items.length > 0 ? items[0].key : "";
        }
        this.layOut();
        this.render();
    }

    layOut() {
        this.starts = new Float64Array(this.items.length + 1);
        for (let i = 0; i < this.items.length; ++i) {
            this.starts[i + 1] = this.starts[i] + this.heights[i];
        }
        this.total = this.starts[this.items.length];
        this.height = Math.min(this.total, kGreatestHeight);
        this.root.style.height = this.isPrinting ? "" : `${this.height}px`;
    }

    // How far into the lines the window begins.
    viewTop() {
        const top = Math.max(0, -this.root.getBoundingClientRect().top);
        return this.total > this.height ? Math.min(top * this.ratio(), this.total) : top;
    }

    ratio() {
        const view = window.innerHeight;
        return this.total > this.height ? (this.total - view) / (this.height - view) : 1;
    }

    indexAt(place) {
        return lastStart(this.starts, place, 0, this.items.length);
    }

    render() {
        if (this.isPrinting || this.items.length === 0) {
            return;
        }
        for (let pass = 0; pass < 4; ++pass) {
            this.place();
            if (!this.measure()) {
                return;
            }
            this.layOut();
        }
        this.place();
    }

    place() {
        const top = this.viewTop();
        const first = this.indexAt(top - kBeyondView);
        const last = Math.min(this.items.length - 1, this.indexAt(top + window.innerHeight + kBeyondView));
        const wanted = new Set();
        for (let i = first; i <= last; ++i) {
            wanted.add(i);
        }
        // The line with the focus stays, or the focus would be lost.
        const active = this.places.get(this.activeKey);
        if (active !== undefined) {
            wanted.add(active);
        }
        this.show([...wanted].sort((one, other) => one - other), this.total > this.height ? top / this.ratio() - top : 0);
    }

    show(indexes, shift) {
        const keys = new Set(indexes.map((i) => this.items[i].key));
        for (const [key, made] of this.elements) {
            if (!keys.has(key)) {
                made.remove();
                this.elements.delete(key);
            }
        }
        let next = this.root.firstChild;
        for (const i of indexes) {
            const made = this.elementOf(i);
            if (made === next) {
                next = next.nextSibling;
            } else {
                this.root.insertBefore(made, next);
            }
            made.style.transform = `translateY(${this.starts[i] + shift}px)`;
            made.setAttribute("aria-posinset", i + 1);
            made.setAttribute("aria-setsize", this.items.length);
        }
    }

    elementOf(i) {
        const item = this.items[i];
        let made = this.elements.get(item.key);
        if (!made) {
            made = this.draw(item);
            made.dataset.key = item.key;
            made.setAttribute("role", "listitem");
            made.setAttribute("aria-level", item.level);
            this.elements.set(item.key, made);
            this.markActive(made, item.key === this.activeKey);
        }
        return made;
    }

    // Whether any line in the document is not as high as assumed.
    measure() {
        const types = new Set();
        let changed = false;
        for (const [key, made] of this.elements) {
            const i = this.places.get(key);
            const { type } = this.items[i];
            const { height } = made.getBoundingClientRect();
            changed = changed || Math.abs(height - this.heights[i]) > 0.01;
            if (Math.abs(height - this.usual[type]) > 0.01 && kAlikeTypes.has(type)) {
                types.add(type);
            }
            this.heights[i] = this.usual[type] = height;
            this.measured[i] = 1;
        }
        if (types.size > 0) {
            this.assume(types);
        }
        return changed || types.size > 0;
    }

    // Lines of these types that were never drawn are as high as those that were.
    assume(types) {
        this.items.forEach((item, i) => {
            if (this.measured[i] === 0 && types.has(item.type)) {
                this.heights[i] = this.usual[item.type];
            }
        });
    }

    markActive(made, isActive) {
        const line = made.querySelector(".line");
        if (line) {
            line.tabIndex = isActive ? 0 : -1;
        }
    }

    setActive(key) {
        const before = this.elements.get(this.activeKey);
        if (before) {
            this.markActive(before, false);
        }
        this.activeKey = key;
        const after = this.elements.get(key);
        if (after) {
            this.markActive(after, true);
        }
    }

    // Brings the line into view and gives it the focus. `inset` is covered at the top of the window. Lines that are drawn on the way
    // may turn out to have other heights, so the place is looked at again.
    focus(key, inset) {
        this.setActive(key);
        for (let pass = 0; pass < 3; ++pass) {
            this.render();
            const box = this.elements.get(key).getBoundingClientRect();
            if (box.top < inset) {
                window.scrollBy(0, (box.top - inset - 8) / this.ratio());
            } else if (box.bottom > window.innerHeight) {
                window.scrollBy(0, (box.bottom - window.innerHeight + 8) / this.ratio());
            }
        }
        this.render();
        this.elements.get(key).querySelector(".line").focus({ preventScroll: true });
    }

    // Puts up to `most` lines into the document, one behind the other; returns how many are left out.
    showForPrint(most) {
        this.isPrinting = true;
        this.root.style.height = "";
        this.root.classList.add("static");
        const count = Math.min(most, this.items.length);
        for (const made of this.elements.values()) {
            made.remove();
        }
        this.elements.clear();
        for (let i = 0; i < count; ++i) {
            this.root.append(this.elementOf(i));
        }
        return this.items.length - count;
    }

    endPrint() {
        this.isPrinting = false;
        this.root.classList.remove("static");
        this.setItems(this.items, false);
    }
}
