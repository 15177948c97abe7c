/** Returns the rows of comma-separated values as objects, keyed by the fields of the first line. */
export function parseCsv(text) {
    const [names, ...rows] = cells(text);
    return rows.map(row => Object.fromEntries((names ?? []).map((name, i) => [name, row[i] ?? ""])));
}

function cells(text) {
    const rows = [];
    let row = [];
    // Each match is one field, quoted or not, and the character that ends it.
    const field = /(?:"((?:[^"]|"")*)"|([^",\r\n]*))(,|\r?\n|$)/gy;
    while (field.lastIndex < text.length) {
        const match = field.exec(text);
        if (!match)
            throw new Error("malformed CSV");
        row.push(match[1] === undefined ? match[2] : match[1].replaceAll("\"\"", "\""));
        if (match[3] !== ",") {
            rows.push(row);
            row = [];
        }
    }
    if (row.length > 0) // the text ends with a comma
        rows.push([...row, ""]);
    return rows;
}
