// Keys in the list of findings. Only one line can be reached with the tabulator; arrows go from line to line.

function listenToKeys(root, findings) {
    const { list } = findings;

    function isLine(i) {
        return list.items[i].type === "finding" || list.items[i].type === "row";
    }

    // The next line from `i` on, `i` excluded; -1 if there is none.
    function next(i, step) {
        for (let at = i + step; at >= 0 && at < list.items.length; at += step) {
            if (isLine(at)) {
                return at;
            }
        }
        return -1;
    }

    function goTo(i) {
        if (i >= 0) {
            list.focus(list.items[i].key, coveredAtTop());
        }
    }

    async function open(key) {
        if (!findings.isOpen(key)) {
            await findings.toggle(key);
        } else {
            const child = next(list.places.get(key), 1);
            if (child >= 0 && list.items[child].level > list.items[list.places.get(key)].level) {
                goTo(child);
            }
        }
    }

    async function close(key) {
        if (findings.isOpen(key)) {
            await findings.toggle(key);
            return;
        }
        const i = list.places.get(key);
        if (list.items[i].type === "row") {
            goTo(list.places.get(`f${list.items[i].choice.finding.first}`));
        }
    }

    root.addEventListener("keydown", (event) => {
        const line = event.target.closest(".line");
        if (!line || event.altKey || event.ctrlKey || event.metaKey) {
            return;
        }
        const { key } = line.closest(".item").dataset;
        const i = list.places.get(key);
        const actions = {
            ArrowDown: () => goTo(next(i, 1)),
            ArrowUp: () => goTo(next(i, -1)),
            ArrowRight: () => open(key),
            ArrowLeft: () => close(key),
            Home: () => goTo(next(-1, 1)),
            End: () => goTo(next(list.items.length, -1)),
        };
        if (actions[event.key]) {
            event.preventDefault();
            actions[event.key]();
        }
    });
}

// How much of the window the filters cover while they stay at its top.
function coveredAtTop() {
    const filters = byId("filters");
    return getComputedStyle(filters).position === "sticky" ? filters.offsetHeight : 0;
}
