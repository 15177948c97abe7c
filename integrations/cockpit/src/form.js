// The form of a task: its fields, each with mihost's explanation.
import { _ } from "./cockpit.js";
import { el, replace } from "./dom.js";

const types = { number: "text", day: "date", password: "password" };
const reasons = {
    missing: () => _("Enter a value."),
    number: () => _("Enter a number."),
    different: () => _("The passwords differ."),
    line: () => _("Enter a single line."),
};

export class Form {
    /** Fixed values are shown and cannot be changed; the others are the first values of the fields. */
    constructor(task, { fixed, values, onInput }) {
        this.task = task;
        this.fixed = fixed;
        this.inputs = new Map();
        this.faults = new Map();
        this.meanings = new Map();
        this.element = el("div", { class: "pf-v6-c-form" }, task.fields.map(field => [
            this.group(field, fixed[field.name] ?? values[field.name], onInput),
            field.kind === "password" && this.group(
                { ...field, name: `${field.name}-again`, label: () => _("Password again") }, "", onInput),
        ]));
    }

    group({ name, label, kind, required }, value, onInput) {
        const id = `field-${name}`;
        const fault = el("span", { class: "mi-fault", id: `${id}-fault` });
        const meaning = el("span", { id: `${id}-help` });
        const input = el("input", {
            id, name,
            type: types[kind] ?? "text",
            value: value ?? "",
            inputmode: kind === "number" ? "numeric" : null,
            autocomplete: kind === "password" ? "new-password" : "off",
            autocapitalize: "none",
            spellcheck: "false",
            required: Boolean(required),
            readonly: name in this.fixed,
            "aria-describedby": `${id}-help ${id}-fault`,
            on: { input: onInput },
        });
        this.inputs.set(name, input);
        this.faults.set(name, fault);
        this.meanings.set(name, meaning);
        return el("div", { class: "pf-v6-c-form__group" },
            el("div", { class: "pf-v6-c-form__group-label" },
                el("label", { class: "pf-v6-c-form__label", for: id },
                    el("span", { class: "pf-v6-c-form__label-text" }, label()),
                    required && el("span", { class: "pf-v6-c-form__label-required", "aria-hidden": "true" }, " *"))),
            el("div", { class: "pf-v6-c-form__group-control" },
                el("span", { class: `pf-v6-c-form-control${name in this.fixed ? " pf-m-readonly" : ""}` }, input),
                el("div", { class: "mi-help" }, fault, meaning)));
    }

    /** Shows below each field mihost's explanation of its parameter. */
    explain(parameters) {
        for (const { name, parameter } of this.task.fields)
            replace(this.meanings.get(name), parameters.get(parameter)?.meaning);
    }

    values() {
        return Object.fromEntries([...this.inputs].map(([name, input]) => [name, input.value]));
    }

    showFaults(faults) {
        for (const [name, element] of this.faults) {
            const fault = faults.find(other => other.name === name);
            replace(element, fault ? `${reasons[fault.reason]()} ` : null);
            this.inputs.get(name).setAttribute("aria-invalid", String(Boolean(fault)));
        }
        if (faults.length > 0)
            this.inputs.get(faults[0].name).focus();
    }

    focus() {
        const first = [...this.inputs.values()].find(input => !input.readOnly);
        first?.focus();
    }
}
