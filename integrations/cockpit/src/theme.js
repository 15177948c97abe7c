// Follows the style that is chosen in Cockpit's menu: light, dark or that of the system.
const system = window.matchMedia("(prefers-color-scheme: dark)");

function apply(style) {
    const dark = style === "dark" || (style !== "light" && system.matches);
    document.documentElement.classList.toggle("pf-v6-theme-dark", dark);
}

function chosen() {
    return window.localStorage.getItem("shell:style") ?? "auto";
}

export function followTheme() {
    apply(chosen());
    system.addEventListener("change", () => apply(chosen()));
    window.addEventListener("storage", event => event.key === "shell:style" && apply(chosen()));
    window.addEventListener("cockpit-style", event => event.detail?.style && apply(event.detail.style));
}
