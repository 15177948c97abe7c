// What the tables of accounts and groups show of the rows that mihost prints.

const lastDay = "2038-01-19"; // an account that never expires
const forEver = 99999; // days

/** The day of a date, "never" for the one that means it, or the text itself for an unknown one. */
export function expiryText(date, never) {
    return date.startsWith(lastDay) ? never : dayText(date);
}

export function dayText(date) {
    return date.split(" ")[0];
}

export function daysText(days, endless) {
    return Number(days) >= forEver ? endless : days;
}

/** How many names a list such as a group's members has. */
export function countNames(names) {
    return names === "" || names === "-" ? 0 : names.split(",").length;
}
