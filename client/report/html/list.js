// A list of lines of which only those in the window are in the document. Lines have keys; an element stays as long as its line is in
// view. Heights are measured when a line is drawn; until then a line is as high as the last one of its type.
//
// Browsers limit the height of an element. A longer list is drawn in one of the greatest height, and scrolls faster.

const kGreatestHeight = 12000000;
const kBeyondView = 400;

class WindowedList {
    // `draw(item)` makes the element of an item { key, type, level }.
    constructor(root, draw) {
        this.root = root;
        this.draw = draw;
        this.items = [];
        this.elements = new Map();
        this.usual = { finding: 36, row: 30, tools: 44, values: 160 };
        this.activeKey = "";
        this.isPrinting = false;
        window.addEventListener("scroll", () => this.schedule(), { passive: true });
        new ResizeObserver(() => this.schedule()).observe(root);
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
        if (this.heights && keeps) {
            this.items.forEach((item, i) => heights.set(item.key, this.heights[i]));
        }
        this.items = items;
        this.heights = Float32Array.from(items, (item) => heights.get(item.key) || this.usual[item.type]);
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
        let low = 0;
        let high = this.items.length;
        while (high - low > 1) {
            const middle = (low + high) >> 1;
            if (this.starts[middle] <= place) {
                low = middle;
            } else {
                high = middle;
            }
        }
        return low;
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
        let changed = false;
        for (const [key, made] of this.elements) {
            const i = this.places.get(key);
            const { height } = made.getBoundingClientRect();
            if (Math.abs(height - this.heights[i]) > 0.01) {
                this.heights[i] = height;
                changed = true;
            }
            this.usual[this.items[i].type] = height;
        }
        return changed;
    }

    // All lines have changed their heights, as after the window was made narrower.
    forgetHeights() {
        for (const [key, made] of this.elements) {
            this.usual[this.items[this.places.get(key)].type] = made.getBoundingClientRect().height;
        }
        this.heights = Float32Array.from(this.items, (item) => this.usual[item.type]);
        this.layOut();
        this.render();
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

    // Brings the line into view and gives it the focus. `inset` is covered at the top of the window.
    focus(key, inset) {
        const i = this.places.get(key);
        this.setActive(key);
        const top = this.viewTop() + inset + Math.min(0, -this.root.getBoundingClientRect().top);
        const bottom = this.viewTop() + window.innerHeight - Math.max(0, this.root.getBoundingClientRect().top);
        if (this.starts[i] < top) {
            window.scrollBy(0, (this.starts[i] - top - 8) / this.ratio());
        } else if (this.starts[i + 1] > bottom) {
            window.scrollBy(0, (this.starts[i + 1] - bottom + 8) / this.ratio());
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
