// Whether the page is visible: not while another page of Cockpit or another tab is shown.
import { cockpit } from "./cockpit.js";

const listeners = [];

export function isVisible() {
    return !cockpit.hidden && document.visibilityState === "visible";
}

/** Calls back whenever the page becomes visible or hidden. */
export function onVisibility(listener) {
    listeners.push(listener);
}

function changed() {
    listeners.forEach(listener => listener(isVisible()));
}

cockpit.addEventListener("visibilitychange", changed);
document.addEventListener("visibilitychange", changed);
