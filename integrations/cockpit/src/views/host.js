// The machine: memory and processes over the session, restart and halt.
import { button } from "../button.js";
import * as catalogue from "../catalogue.js";
import { _, cockpit, format } from "../cockpit.js";
import { el, replace, svg } from "../dom.js";
import { pointsOf } from "../history.js";
import { Loader } from "../load.js";
import { tasks } from "../tasks.js";

const width = 300;
const height = 80;

// The top of a chart is another figure or, if none is given, the greatest value so far.
const charts = [
    { figure: "physical-memory-used", most: "physical-memory-size", title: () => _("Memory in use") },
    { figure: "swap-used", most: "swap-size", title: () => _("Swap in use") },
    { figure: "process-count", most: null, title: () => _("Processes") },
];

export class HostView {
    constructor({ state, preview, monitor }) {
        this.monitor = monitor;
        this.message = el("div", {});
        this.loader = new Loader(this.message, state);
        this.charts = el("div", { class: "mi-charts" });
        this.element = el("div", { class: "mi-grows" },
            el("section", { class: "mi-card", "aria-label": _("Figures") },
                el("h2", { class: "pf-v6-c-title pf-m-xl" }, _("Since this page was opened")),
                this.message, this.charts),
            el("section", { class: "mi-card", "aria-label": _("Power") },
                el("h2", { class: "pf-v6-c-title pf-m-xl" }, _("Power")),
                el("div", { class: "mi-toolbar" },
                    button(_("Restart"), () => preview(tasks.restart), {
                        id: "host-restart", look: "danger", changes: true,
                    }),
                    button(_("Halt"), () => preview(tasks.halt), {
                        id: "host-halt", look: "danger", changes: true,
                    }))));
    }

    show() {
        this.monitor.onSample = () => this.draw();
        this.monitor.onFailure = failure => failure && this.loader.failed(failure, () => this.show());
        this.monitor.start();
        this.loader.load(() => [{ answer: catalogue.properties(), stop() {} }], kinds => {
            replace(this.message);
            this.units = kinds.get("os").properties;
            this.draw();
        });
    }

    hide() {
        this.loader.stop();
        this.monitor.onSample = () => {};
        this.monitor.onFailure = () => {};
    }

    draw() {
        const { samples } = this.monitor.history;
        replace(this.charts, samples.length === 0 ? el("p", { class: "mi-note" }, _("No figures yet."))
            : charts.map(chart => this.chart(chart, samples)));
    }

    chart({ figure, most, title }, samples) {
        const last = samples[samples.length - 1];
        const limit = most ? last[most] : Math.max(...samples.map(sample => sample[figure])) * 1.25;
        const unit = this.units?.get(most ?? figure)?.unit ?? "";
        const points = pointsOf(samples, figure, { width, height, most: limit });
        const now = amount(last[figure], unit);
        const text = !most ? now : limit === 0 ? _("none") : format(_("$0 of $1"), now, amount(limit, unit));
        return el("figure", { class: "mi-chart", "data-figure": figure },
            el("figcaption", {}, el("strong", {}, title()), el("span", { class: "mi-note" }, text)),
            svg("svg", {
                viewBox: `0 0 ${width} ${height}`, preserveAspectRatio: "none", role: "img",
                "aria-label": `${title()}: ${text}`,
            },
            svg("polygon", { class: "mi-chart__area", points: area(points) }),
            svg("polyline", { class: "mi-chart__line", points: points.map(({ x, y }) => `${x},${y}`).join(" ") })));
    }
}

function area(points) {
    if (points.length === 0)
        return "";
    return [{ x: points[0].x, y: height }, ...points, { x: points[points.length - 1].x, y: height }]
        .map(({ x, y }) => `${x},${y}`).join(" ");
}

/** Returns memory in its usual unit, anything else as mihost prints it. */
function amount(number, unit) {
    return unit === "KiB" ? cockpit.format_bytes(number * 1024) : `${number} ${unit}`;
}
