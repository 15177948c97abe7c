// A run of mihost that continues while the page is visible.
import * as mihost from "./mihost.js";
import { isVisible, onVisibility } from "./visibility.js";

const all = new Set();

onVisibility(visible => all.forEach(live => live.setVisible(visible)));

export class Live {
    /**
     * Calls back whenever mihost is started, with each document that it prints, and, if it ends without
     * being stopped, with a failure or null. A silent run may print nothing for a long time.
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
