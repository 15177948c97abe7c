/** What is shown of each property: the row of 'mihost get' with what the catalogue knows about it. */
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

/** A live value as 'mihost get' shows it, or null for one that only mihost can show, such as a date. */
export function liveText({ kind, value }) {
    if (kind === "date" || value === null)
        return null;
    return Array.isArray(value) ? value.join(",") : String(value);
}
