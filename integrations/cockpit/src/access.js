// Whether the account that is logged in has the privilege to change the machine.
import { cockpit } from "./cockpit.js";

const permission = cockpit.permission({ admin: true });

/** Also true while Cockpit does not know yet. */
export function allowed() {
    return permission.allowed !== false;
}

/** Calls back now and whenever the privilege changes. Buttons that change the machine need no call. */
export function watchAccess(listener) {
    let last = null;
    const changed = () => {
        if (allowed() === last)
            return;
        last = allowed();
        for (const button of document.querySelectorAll("[data-changes]"))
            button.disabled = !last;
        listener(last);
    };
    permission.addEventListener("changed", changed);
    changed();
}
