// The two packed parts of the page. The overview is small JSON; the rows are columns of numbers and one long text that all texts are
// parts of. A text is cut out when it is shown.

async function unpack(id) {
    const packed = byId(id).textContent;
    const bytes = Uint8Array.fromBase64 ? Uint8Array.fromBase64(packed)
        : Uint8Array.from(atob(packed), (character) => character.charCodeAt(0));
    const stream = new Blob([bytes]).stream().pipeThrough(new DecompressionStream("gzip"));
    return new Response(stream).arrayBuffer();
}

async function readOverview() {
    return JSON.parse(new TextDecoder().decode(await unpack("overview-data")));
}

class Rows {
    static async read() {
        return new Rows(await unpack("rows-data"));
    }

    constructor(buffer) {
        const length = new DataView(buffer).getUint32(0, true);
        const head = JSON.parse(new TextDecoder().decode(new Uint8Array(buffer, 4, length)));
        let at = 4 + length;
        for (const [name, count] of head.columns) {
            this[name] = new Uint32Array(buffer, at, count);
            at += 4 * count;
        }
        this.allText = new TextDecoder("utf-8", { ignoreBOM: true }).decode(new Uint8Array(buffer, at));
        this.textStart = new Uint32Array(this.textLength.length + 1);
        for (let i = 0; i < this.textLength.length; ++i) {
            this.textStart[i + 1] = this.textStart[i] + this.textLength[i];
        }
    }

    text(number) {
        return this.allText.substring(this.textStart[number], this.textStart[number + 1]);
    }

    // For each text whether it contains the query, which is in lower case.
    textsWith(query) {
        this.lowerText = this.lowerText || lowered(this.allText);
        const found = new Uint8Array(this.textLength.length);
        let text = 0;
        for (let at = this.lowerText.indexOf(query); at >= 0; at = this.lowerText.indexOf(query, at)) {
            text = this.textAt(at, text);
            const end = this.textStart[text + 1];
            if (at + query.length <= end) {
                found[text] = 1;
                at = end;
            } else {
                at += 1;
            }
        }
        return found;
    }

    // The text that a place of the long text is in; `least` is one at or before it.
    textAt(place, least) {
        return lastStart(this.textStart, place, least, this.textLength.length);
    }

    // The end of what begins at `starts[i]`.
    end(starts, i, all) {
        return i + 1 < starts.length ? starts[i + 1] : all.length;
    }

    list(number) {
        return number === 0 ? [] : this.number.subarray(this.listNumbers[number], this.end(this.listNumbers, number, this.number));
    }

    instance(number) {
        return {
            name: this.text(this.instanceName[number]),
            key: this.text(this.instanceKey[number]),
            lacking: this.instanceLacking[number],
            sharing: this.list(this.instanceSharing[number]),
            path: this.text(this.instancePath[number]),
        };
    }

    change(number) {
        const groups = [];
        for (let i = this.changeGroups[number]; i < this.end(this.changeGroups, number, this.groupValue); ++i) {
            groups.push({ value: this.text(this.groupValue[i]), set: this.groupSet[i], counts: this.list(this.groupCounts[i]) });
        }
        return { reference: this.text(this.changeReference[number]), short: this.text(this.changeShort[number]), groups };
    }

    contents(number) {
        const pairs = [];
        for (let i = this.contentPairs[number]; i < this.end(this.contentPairs, number, this.pairProperty); ++i) {
            pairs.push([this.text(this.pairProperty[i]), this.text(this.pairValue[i])]);
        }
        return pairs;
    }

    disagreements(number) {
        const list = [];
        const end = this.end(this.contentDisagreements, number, this.disagreementProperty);
        for (let i = this.contentDisagreements[number]; i < end; ++i) {
            list.push({ property: this.text(this.disagreementProperty[i]), change: this.change(this.disagreementChange[i]) });
        }
        return list;
    }
}

// Of ascending starts, the position of the last one that is not behind `place`, from `low` on and before `high`.
function lastStart(starts, place, low, high) {
    while (high - low > 1) {
        const middle = (low + high) >> 1;
        if (starts[middle] <= place) {
            low = middle;
        } else {
            high = middle;
        }
    }
    return low;
}
