/**
 * Returns the arguments of mihost for a task with these values, and what it reads from standard input.
 * A password is passed only there.
 */
export function commandOf(task, values) {
    const options = [];
    const places = [];
    let input = "";
    for (const { name, option, kind, absent } of task.fields) {
        const value = values[name] || absent || "";
        if (kind === "password") {
            if (value === "")
                continue;
            input = `${value}\n`;
            if (option)
                options.push(option);
        } else if (!option) {
            places.push(value);
        } else if (value !== "") {
            options.push(`${option}=${value}`);
        }
    }
    return { words: [...task.words, ...options, ...(places.length > 0 ? ["--", ...places] : [])], input };
}

/** Returns the name and the reason of each field whose value is missing or wrong. */
export function faultsOf(task, values) {
    const faults = [];
    for (const { name, required, kind } of task.fields) {
        const value = values[name] ?? "";
        if (required && value === "")
            faults.push({ name, reason: "missing" });
        else if (kind === "number" && value !== "" && !/^\d+$/.test(value))
            faults.push({ name, reason: "number" });
        else if (kind === "password" && value !== (values[`${name}-again`] ?? ""))
            faults.push({ name: `${name}-again`, reason: "different" });
        else if (/[\n\r]/.test(value))
            faults.push({ name, reason: "line" });
    }
    return faults;
}
