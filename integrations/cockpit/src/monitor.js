// Figures of the machine since the page was opened.
import { History } from "./history.js";
import { Live } from "./live.js";

const interval = "5"; // seconds
const properties = [
    "process-count", "physical-memory-size", "physical-memory-free", "swap-size", "swap-used",
];

export class Monitor {
    constructor() {
        Object.assign(this, { history: new History(), figures: {}, live: null });
        this.onSample = () => {};
        this.onFailure = () => {};
    }

    start() {
        this.live ??= new Live(["watch", "--interval", interval, "os", ...properties], {
            onDocument: document => this.sample(document),
            onEnd: failure => {
                this.live = null;
                this.onFailure(failure);
            },
        });
    }

    /** mihost prints only what changed. */
    sample({ time, properties: changed }) {
        for (const [name, { value }] of Object.entries(changed))
            this.figures[name] = value;
        this.history.add({
            time,
            ...this.figures,
            "physical-memory-used": this.figures["physical-memory-size"] - this.figures["physical-memory-free"],
        });
        this.onSample();
    }
}
