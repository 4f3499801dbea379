// On paper there is no window: the lines stand one behind the other, up to a number that can still be laid out.

const kMostPrinted = 3000;

function listenToPrinting(findings) {
    window.addEventListener("beforeprint", () => {
        const left = findings.list.showForPrint(kMostPrinted);
        byId("printed").hidden = left === 0;
        byId("printed").textContent = `${counted(left, "more line")} not printed. Filter the findings to print these.`;
    });
    window.addEventListener("afterprint", () => {
        byId("printed").hidden = true;
        findings.list.endPrint();
    });
}
