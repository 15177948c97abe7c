// The dialog of a change: its form, what would happen, and then the change itself.
import { button } from "./button.js";
import * as catalogue from "./catalogue.js";
import { _ } from "./cockpit.js";
import { commandOf, faultsOf } from "./command.js";
import { el, replace } from "./dom.js";
import { Form } from "./form.js";
import { spinner } from "./load.js";
import * as mihost from "./mihost.js";
import { outcome } from "./outcome.js";
import { alert } from "./state.js";

export class Preview {
    /**
     * Makes the dialog. Fixed values name what is changed, others are the first values of the form;
     * onDone is called with the task's title after a change.
     */
    constructor(task, { fixed = {}, values = {} } = {}, onDone) {
        Object.assign(this, { task, fixed, values, onDone, busy: false, machine: null, edits: 0 });
        this.fields = new Form(task, { fixed, values, onInput: () => this.forget() });
        this.meaning = el("p", { class: "mi-note" });
        this.form = el("form", {
            id: "preview-form", novalidate: true, on: { submit: event => this.submitted(event) },
        }, this.meaning, this.fields.element);
        this.result = el("div", { class: "mi-result", "aria-live": "polite" });
        this.confirm = el("input", {
            id: "confirm-name", autocomplete: "off", autocapitalize: "none", spellcheck: "false",
            on: { input: () => this.update(), keydown: event => event.key === "Enter" && this.apply.click() },
        });
        this.confirmation = el("div", { class: "mi-confirm", hidden: true },
            el("label", { for: "confirm-name" }, task.danger?.label()),
            el("span", { class: "pf-v6-c-form-control" }, this.confirm));
        this.run = button(_("What would happen?"), null, {
            id: "preview-run", look: "primary", submits: "preview-form",
        });
        this.apply = button(_("Apply"), () => this.doIt(), {
            id: "preview-apply", look: task.danger ? "danger" : "primary",
        });
        this.cancel = button(_("Cancel"), () => this.close(), { id: "preview-cancel", look: "link" });
        this.element = el("dialog", {
            id: "preview", class: "mi-dialog", "aria-labelledby": "preview-title",
            on: {
                cancel: event => {
                    event.preventDefault();
                    this.close();
                },
            },
        },
        el("h2", { id: "preview-title", class: "pf-v6-c-title pf-m-xl" }, task.title()),
        el("div", { class: "mi-dialog__body" }, this.form, this.result, this.confirmation),
        el("footer", { class: "mi-dialog__footer" }, this.run, this.apply, this.cancel));
        this.update();
    }

    /** Shows the dialog; the meaning of its fields and the machine's name may follow a moment later. */
    open() {
        document.body.append(this.element);
        this.element.showModal();
        this.fields.focus();
        const { task } = this;
        if (task.method)
            catalogue.methods().then(methods => {
                const { meaning, parameters } = methods.get(task.method);
                replace(this.meaning, meaning);
                this.fields.explain(parameters);
            }, () => {}); // the preview has the same problem, and shows it
        if (task.danger?.name === "machine")
            mihost.text(["-o", "value", "get", "computer", "computer-name"]).answer.then(name => {
                this.machine = name.trim();
                this.update();
            }, failure => this.failed(failure));
    }

    close() {
        if (this.applying)
            return;
        this.current?.stop();
        this.element.close();
        this.element.remove();
    }

    submitted(event) {
        event.preventDefault();
        this.tryIt();
    }

    /** Drops the preview, since the form has changed. */
    forget() {
        this.edits++;
        if (!this.previewed)
            return;
        this.previewed = null;
        replace(this.result);
        this.update();
    }

    update() {
        const wanted = this.wantedName();
        const confirmed = !this.task.danger || (wanted && this.confirm.value === wanted);
        this.confirmation.hidden = !(this.task.danger && this.previewed);
        this.run.disabled = this.busy;
        this.apply.disabled = this.busy || !this.previewed || !confirmed;
        this.cancel.disabled = Boolean(this.applying);
        this.run.classList.toggle("pf-m-primary", !this.previewed);
        this.run.classList.toggle("pf-m-secondary", Boolean(this.previewed));
    }

    /** Returns the name to type before a dangerous change; none while it is not known. */
    wantedName() {
        const { danger } = this.task;
        if (!danger)
            return null;
        return danger.name === "machine" ? this.machine : danger.name(this.fixed);
    }

    async tryIt() {
        if (this.busy)
            return;
        const values = this.fields.values();
        const faults = faultsOf(this.task, values);
        this.fields.showFaults(faults);
        if (faults.length > 0)
            return;
        this.previewed = null;
        const { edits } = this;
        const command = commandOf(this.task, values);
        const answer = await this.change(command, true);
        if (!answer)
            return;
        if (edits !== this.edits) {
            replace(this.result, alert("info", _("The form was changed; preview the change again")));
            return;
        }
        replace(this.result, outcome(answer, { preview: true }));
        if (!answer.error)
            this.previewed = command;
        this.update();
        this.result.scrollIntoView({ block: "nearest" });
        if (this.previewed && this.task.danger)
            this.confirm.focus();
        else if (this.previewed)
            this.apply.focus();
    }

    async doIt() {
        if (this.apply.disabled)
            return;
        this.applying = true;
        const answer = await this.change(this.previewed, false);
        this.applying = false;
        this.previewed = null; // whether it failed or not, the next change needs a new preview
        this.update();
        if (!answer)
            return;
        if (answer.error) {
            replace(this.result, outcome(answer, { preview: false }));
            return;
        }
        this.close();
        this.onDone({ title: this.task.title(), answer });
    }

    async change({ words, input }, preview) {
        this.busy = true;
        this.update();
        replace(this.result, spinner());
        try {
            this.current = mihost.change(words, { preview, input });
            return await this.current.answer;
        } catch (failure) {
            this.failed(failure);
            return null;
        } finally {
            this.busy = false;
            this.update();
        }
    }

    failed(failure) {
        if (!failure.kind)
            throw failure;
        const titles = {
            killed: _("mihost was stopped before it had answered"),
            missing: _("mihost is not installed on this machine"),
            cancelled: _("This was stopped"),
        };
        replace(this.result, alert("danger", titles[failure.kind] ?? _("mihost could not do this"), [failure.message]));
    }
}
