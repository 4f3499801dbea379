// Elements. Whatever comes from an inventory becomes a text node here and is never parsed as markup.

function byId(id) {
    return document.getElementById(id);
}

// element("td", { class: "n", "aria-label": "…" }, "text", child, …)
function element(tag, attributes, ...children) {
    const made = document.createElement(tag);
    for (const [name, value] of Object.entries(attributes || {})) {
        if (value === true) {
            made.setAttribute(name, "");
        } else if (value !== false && value !== null && value !== undefined) {
            made.setAttribute(name, value);
        }
    }
    made.append(...children.filter((child) => child !== null && child !== undefined));
    return made;
}

const numbers = new Intl.NumberFormat("en");

function formatted(number) {
    return numbers.format(number);
}

function counted(number, one, many = one + "s") {
    return `${formatted(number)} ${number === 1 ? one : many}`;
}

// The beginning of a text that may be long, for a line that does not show more anyway.
function cut(text, length = 300) {
    return text.length <= length ? text : text.slice(0, length) + "…";
}

// The text as nodes, with what was searched for marked.
function marked(text, query) {
    const fragment = document.createDocumentFragment();
    const lower = query ? lowered(text) : "";
    let start = 0;
    for (let at = query ? lower.indexOf(query) : -1; at >= 0; at = lower.indexOf(query, start)) {
        fragment.append(text.slice(start, at), element("mark", {}, text.slice(at, at + query.length)));
        start = at + query.length;
    }
    fragment.append(text.slice(start));
    return fragment;
}

// In lower case and of the same length: only this capital letter has a longer form.
function lowered(text) {
    return text.replaceAll("\u0130", "i").toLowerCase();
}
