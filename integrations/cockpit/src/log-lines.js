/** Returns the lines of 'mihost --json list log', oldest first, as 'list log --follow' prints them. */
export function logLines(nodes) {
    return nodes.map(({ properties: { time, message } }) => ({
        time: time?.value ?? null,
        // Asterisks are around each message.
        message: (message?.value ?? "").replace(/^\*([\s\S]*)\*$/, "$1"),
    })).reverse();
}

/** Returns whether a line's text contains each word of the filter. */
export function lineMatches(text, filter) {
    const lower = text.toLowerCase();
    return filter.toLowerCase().split(/\s+/).every(word => lower.includes(word));
}
