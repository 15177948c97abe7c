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

/** A fact of 'mihost user', with words for "yes", "no" and "unknown"; the absent text for one that is not there. */
export function factText(account, fact, absent, words) {
    const value = account[fact];
    if (account.unknown && !value) // without the password's entry, "no" says nothing either
        return words.unknown;
    if (typeof value === "boolean")
        return value ? words.yes : words.no;
    return value ?? absent;
}
