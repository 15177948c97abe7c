/** Returns what is shown of each property: the row of 'mihost get' and the catalogue's entry. */
export function propertyRows(rows, known) {
    return rows.map(row => {
        const property = known?.properties.get(row.name);
        return {
            ...row,
            meaning: property?.meaning ?? "",
            live: property?.live ?? false,
            acts: property?.acts ?? false,
            secret: property?.secret ?? false,
        };
    });
}

/** Returns a live value as 'mihost get' shows it; null if only mihost can show it, such as a date. */
export function liveText({ kind, value }) {
    if (kind === "date" || value === null)
        return null;
    return Array.isArray(value) ? value.join(",") : String(value);
}
