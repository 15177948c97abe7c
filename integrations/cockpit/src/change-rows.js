// What a change does to the machine's files, in the order in which it is shown.

/** Returns the files that change and, separately, the account tools' backups. */
export function sortChanges(changes) {
    return {
        files: changes.filter(change => !change.backup),
        backups: changes.filter(change => change.backup),
    };
}

/** Returns what changes in a file: attributes, then removed lines, then added ones. */
export function differenceOf({ removed = [], added = [], mode = null, owner = null }) {
    const attributes = Object.entries({ mode, owner }).filter(([, value]) => value !== null);
    return [
        ...attributes.map(([name, { before, after }]) =>
            ({ sign: " ", text: `${name}: ${before ?? "-"} → ${after ?? "-"}` })),
        ...removed.map(text => ({ sign: "-", text })),
        ...added.map(text => ({ sign: "+", text })),
    ];
}
