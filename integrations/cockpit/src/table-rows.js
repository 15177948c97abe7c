// Which rows of a table are shown, and in which order.

/** Returns the rows that contain each word of the filter, each word within one column. */
export function filterRows(rows, columns, filter) {
    const words = filter.toLowerCase().split(/\s+/).filter(Boolean);
    if (words.length === 0)
        return rows;
    return rows.filter(row => {
        const text = columns.map(column => column.text(row)).join("\n").toLowerCase();
        return words.every(word => text.includes(word));
    });
}

function compare(a, b, order) {
    if (order === "number") {
        const [x, y] = [Number(a), Number(b)];
        // Values that are not numbers, such as unknown ones, come last.
        if (Number.isNaN(x) || Number.isNaN(y))
            return Number.isNaN(x) - Number.isNaN(y);
        return x - y;
    }
    return a < b ? -1 : a > b ? 1 : 0;
}

/** Returns the rows in the order of a column; rows that are equal there keep their order. */
export function sortRows(rows, { property, order }, descending) {
    const sign = descending ? -1 : 1;
    return [...rows].sort((a, b) => sign * compare(a[property], b[property], order));
}
