// The oldest mihost whose output this page reads.
export const oldestMihost = "1.0.0";

/** Returns whether the output of 'mihost --version' names a version that this page works with. */
export function isRecent(output, oldest = oldestMihost) {
    const found = /(\d+)\.(\d+)\.(\d+)/.exec(output);
    if (!found)
        return false;
    const wanted = oldest.split(".").map(Number);
    const version = found.slice(1).map(Number);
    const differing = wanted.findIndex((part, i) => part !== version[i]);
    return differing < 0 || version[differing] > wanted[differing];
}
