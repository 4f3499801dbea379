// Which rows the filters select, and how the findings with any of them are ordered.

const kOnlyInReference = 0;
const kOnlyInOthers = 1;
const kChanged = 2;

class Selection {
    constructor(overview) {
        this.overview = overview;
        this.rows = null;  // as soon as they are unpacked
        this.clear();
    }

    clear() {
        this.kinds = new Set();  // empty: all
        this.className = "";
        this.property = "";
        this.inventory = -1;
        this.query = "";
    }

    // Whether the rows must be looked at.
    needsRows() {
        return this.inventory >= 0 || this.query !== "";
    }

    isActive() {
        return this.needsRows() || this.kinds.size > 0 || this.className !== "" || this.property !== "";
    }

    takesFinding(finding) {
        return (this.kinds.size === 0 || this.kinds.has(finding.kind)) &&
            (this.className === "" || this.overview.classes[finding.class].name === this.className) &&
            (this.property === "" || finding.property === this.property);
    }

    // [{ finding, count, rows }]: the findings with selected rows; `rows` is null if all are.
    select(order) {
        const test = this.needsRows() ? this.rowTest() : null;
        const selected = [];
        for (const finding of this.overview.findings) {
            if (!this.takesFinding(finding)) {
                continue;
            }
            const rows = test ? this.rowsOf(finding, test) : null;
            if (!rows || rows.length > 0) {
                selected.push({ finding, rows, count: rows ? rows.length : finding.rows });
            }
        }
        return this.sort(selected, order);
    }

    rowsOf(finding, test) {
        const found = new Uint32Array(finding.rows);
        const all = test.takesAll(finding);
        let count = 0;
        for (let row = finding.first; row < finding.first + finding.rows; ++row) {
            if (test.inInventory(row) && (all || test.hasText(row, finding))) {
                found[count++] = row;
            }
        }
        return found.subarray(0, count);
    }

    rowTest() {
        const rows = this.rows;
        const query = this.query;
        const sets = Uint8Array.from(this.overview.sets, (set) => this.inventory < 0 || set.inventories.includes(this.inventory));
        if (query === "") {
            return { takesAll: () => true, inInventory: (row) => sets[rows.rowSet[row]] };
        }
        const texts = rows.textsWith(query);
        const labels = this.overview.inventories.map((inventory) => lowered(inventory.label).includes(query));
        const named = Uint8Array.from(this.overview.sets, (set) => set.inventories.some((inventory) => labels[inventory]));
        const changes = this.changesWith(texts);
        const contents = this.contentsWith(texts, changes);
        return {
            takesAll: (finding) => lowered(this.overview.classes[finding.class].name).includes(query) ||
                lowered(finding.property).includes(query),
            inInventory: (row) => sets[rows.rowSet[row]],
            hasText: (row, finding) => {
                const instance = rows.rowInstance[row];
                const content = rows.rowContent[row];
                return texts[rows.instanceName[instance]] || texts[rows.instanceKey[instance]] || named[rows.rowSet[row]] ||
                    (finding.kind === kChanged ? changes[content] : contents[content]);
            },
        };
    }

    changesWith(texts) {
        const rows = this.rows;
        const found = new Uint8Array(rows.changeReference.length);
        for (let i = 0; i < found.length; ++i) {
            found[i] = texts[rows.changeReference[i]];
            for (let group = rows.changeGroups[i]; group < rows.end(rows.changeGroups, i, rows.groupValue); ++group) {
                found[i] |= texts[rows.groupValue[group]];
            }
        }
        return found;
    }

    contentsWith(texts, changes) {
        const rows = this.rows;
        const found = new Uint8Array(rows.contentPairs.length);
        for (let i = 0; i < found.length; ++i) {
            for (let pair = rows.contentPairs[i]; pair < rows.end(rows.contentPairs, i, rows.pairProperty); ++pair) {
                found[i] |= texts[rows.pairProperty[pair]] | texts[rows.pairValue[pair]];
            }
            const end = rows.end(rows.contentDisagreements, i, rows.disagreementProperty);
            for (let at = rows.contentDisagreements[i]; at < end; ++at) {
                found[i] |= texts[rows.disagreementProperty[at]] | changes[rows.disagreementChange[at]];
            }
        }
        return found;
    }

    sort(selected, order) {
        if (order === "largest") {
            return selected.sort((one, other) => other.count - one.count);
        }
        if (order === "rarest") {
            return selected.sort((one, other) => one.finding.rarity - other.finding.rarity || one.count - other.count);
        }
        return selected;
    }

    // How many differences the findings stand for: the parts of one are one.
    countDifferences(selected) {
        if (!this.rows || !this.isActive()) {
            return this.overview.counts.differences;
        }
        const seen = new Uint8Array(this.overview.counts.differences);
        let count = 0;
        for (const { finding, rows } of selected) {
            for (let i = 0; i < (rows ? rows.length : finding.rows); ++i) {
                const difference = this.rows.rowDifference[rows ? rows[i] : finding.first + i];
                count += 1 - seen[difference];
                seen[difference] = 1;
            }
        }
        return count;
    }
}
