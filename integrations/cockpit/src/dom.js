// Makes elements from plain values. Texts always become text nodes, so nothing from the machine is markup.
import { visible } from "./visible.js";

const shownAttributes = ["title", "aria-label"];

function fill(element, properties, children) {
    for (const [name, value] of Object.entries(properties)) {
        if (name === "on")
            for (const [event, listener] of Object.entries(value))
                element.addEventListener(event, listener);
        else if (name.startsWith("aria-") && typeof value === "boolean")
            element.setAttribute(name, String(value));
        else if (value === true)
            element.setAttribute(name, "");
        else if (value !== false && value !== null && value !== undefined)
            element.setAttribute(name, shownAttributes.includes(name) ? visible(String(value)) : value);
    }
    append(element, ...children);
    return element;
}

/** Appends texts, numbers, elements and lists of them; only null and false are left out. */
export function append(element, ...children) {
    for (const child of children.flat(Infinity))
        if (child !== null && child !== undefined && child !== false)
            element.append(child instanceof Node ? child : visible(String(child)));
}

export function el(tag, properties = {}, ...children) {
    return fill(document.createElement(tag), properties, children);
}

export function svg(tag, properties = {}, ...children) {
    return fill(document.createElementNS("http://www.w3.org/2000/svg", tag), properties, children);
}

export function replace(element, ...children) {
    element.replaceChildren();
    append(element, ...children);
}
