// A run of mihost that goes on while the page is in sight.
import * as mihost from "./mihost.js";
import { isVisible, onVisibility } from "./visibility.js";

const all = new Set();

onVisibility(visible => all.forEach(live => live.setVisible(visible)));

export class Live {
    /**
     * Calls back whenever mihost is started, with each document that it prints, and with a failure, or
     * null, when it ends although it was not stopped. A silent one may print nothing for long.
     */
    constructor(words, { silent = false, onBegin = () => {}, onDocument, onEnd }) {
        Object.assign(this, { words, silent, onBegin, onDocument, onEnd, run: null });
        all.add(this);
        this.setVisible(isVisible());
    }

    setVisible(visible) {
        if (visible && !this.run)
            this.begin();
        else if (!visible)
            this.end();
    }

    begin() {
        this.onBegin();
        const run = mihost.stream(this.words, document => run === this.run && this.onDocument(document),
            { silent: this.silent });
        this.run = run;
        const ended = failure => {
            if (run !== this.run)
                return;
            this.stop();
            this.onEnd(failure);
        };
        run.answer.then(() => ended(null), ended);
    }

    end() {
        const run = this.run;
        this.run = null;
        run?.stop();
    }

    stop() {
        all.delete(this);
        this.end();
    }
}
