// The page begins with the overview and draws the findings at once. The rows, which may be large, are unpacked afterwards; what needs
// them waits.

function fail(error) {
    byId("failure").hidden = false;
    byId("failure").textContent = typeof DecompressionStream === "undefined"
        ? "This browser cannot unpack the page (it lacks DecompressionStream). Use a browser of 2023 or later."
        : `The page cannot be shown: ${error.message}. Write the report again.`;
}

async function start() {
    const isParsed = new Promise((resolve) => document.addEventListener("DOMContentLoaded", resolve, { once: true }));
    const overview = await readOverview();
    const selection = new Selection(overview);
    const whenRows = isParsed.then(() => Rows.read()).then((rows) => {
        selection.rows = rows;
        findings.setRows(rows);
    });
    const findings = new Findings(overview, byId("list"), whenRows);
    const show = () => {
        const selected = selection.select(byId("order").value);
        findings.show(selected, selection.query);
        filters.sayResult(selected, selection.countDifferences(selected));
        matrix.mark(selection);
    };
    const filters = new Filters(overview, selection, () => (selection.isActive() ? whenRows.then(show) : show()));
    drawHead(overview);
    const matrix = new Matrix(overview, byId("matrix-table"), (choice) => filters.choose(choice));
    drawInventories(overview);
    drawRules(overview);
    drawBaseline(overview);
    drawCoverage(overview);
    listenToKeys(byId("list"), findings);
    listenToPrinting(findings);
    show();
    performance.mark("drawn");
    await whenRows;
    performance.mark("unpacked");
    document.documentElement.dataset.ready = "true";
}

start().catch(fail);
