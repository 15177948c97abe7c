/** Splits text into lines: the function that it returns takes pieces and calls back with whole lines. */
export function lineSplitter(onLine) {
    let rest = "";
    return piece => {
        const lines = (rest + piece).split("\n");
        rest = lines.pop();
        lines.filter(line => line !== "").forEach(onLine);
    };
}
