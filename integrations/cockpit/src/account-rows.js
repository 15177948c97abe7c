// What the tables of accounts and groups show of the rows that mihost prints.

const lastDay = "2038-01-19"; // an account that never expires
const unlimited = 99999; // days

/** Returns the day of a date, "never" for the last possible day, or the text itself if it is not a date. */
export function expiryText(date, never) {
    return date.startsWith(lastDay) ? never : dayText(date);
}

export function dayText(date) {
    return date.split(" ")[0];
}

export function daysText(days, endless) {
    return Number(days) >= unlimited ? endless : days;
}

/** Returns how many names a list has, such as a group's members. */
export function countNames(names) {
    return names === "" || names === "-" ? 0 : names.split(",").length;
}

/** Returns a fact of 'mihost user' in words, also "yes", "no" and "unknown"; the absent text if it is missing. */
export function factText(account, fact, absent, words) {
    const value = account[fact];
    if (account.unknown && !value) // without the password's entry, "no" is not known either
        return words.unknown;
    if (typeof value === "boolean")
        return value ? words.yes : words.no;
    return value ?? absent;
}
