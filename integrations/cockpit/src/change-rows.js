// What a change does to the machine's files, in the order in which it is shown.

/** The files that change: those that matter first, the account tools' backups apart. */
export function sortChanges(changes) {
    const isBackup = change => /^\/etc\/(passwd|shadow|group|gshadow|subuid|subgid)-$/.test(change.file);
    return {
        files: changes.filter(change => !isBackup(change)),
        backups: changes.filter(isBackup),
    };
}

/** The lines of a changed file as a difference: what goes, then what comes. */
export function differenceOf({ removed = [], added = [], mode = null, owner = null }) {
    const attributes = Object.entries({ mode, owner }).filter(([, value]) => value !== null);
    return [
        ...attributes.map(([name, { before, after }]) =>
            ({ sign: " ", text: `${name}: ${before ?? "-"} → ${after ?? "-"}` })),
        ...removed.map(text => ({ sign: "-", text })),
        ...added.map(text => ({ sign: "+", text })),
    ];
}
