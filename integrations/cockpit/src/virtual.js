/** Returns which rows of a list are visible, with a margin of rows above and below. */
export function windowOf({ scrollTop, height, rowHeight, count, margin = 8 }) {
    const first = Math.max(0, Math.min(count, Math.floor(scrollTop / rowHeight)) - margin);
    const last = Math.min(count, Math.ceil((scrollTop + height) / rowHeight) + margin);
    return { first, last: Math.max(first, last) };
}

/**
 * Shows only the visible rows of a long list. The body's first and last elements are spacers as high as
 * the rows that are left out.
 */
export class VirtualRows {
    constructor({ scroller, body, makeSpacer, render, rowHeight }) {
        Object.assign(this, { scroller, body, render, rowHeight, count: 0, rows: new Map() });
        this.before = makeSpacer();
        this.after = makeSpacer();
        body.replaceChildren(this.before, this.after);
        scroller.addEventListener("scroll", () => this.draw(), { passive: true });
        new ResizeObserver(() => this.draw()).observe(scroller);
    }

    /** Sets the number of rows and draws the visible ones again. */
    setCount(count) {
        this.count = count;
        this.rows.forEach(row => row.remove());
        this.rows.clear();
        this.draw();
    }

    scrollTo(index) {
        const head = this.body.offsetTop; // a heading that stays visible
        const top = index * this.rowHeight;
        const { scrollTop, clientHeight } = this.scroller;
        if (top < scrollTop)
            this.scroller.scrollTop = top;
        else if (head + top + this.rowHeight > scrollTop + clientHeight)
            this.scroller.scrollTop = head + top + this.rowHeight - clientHeight;
        this.draw();
    }

    draw() {
        const { first, last } = windowOf({
            scrollTop: this.scroller.scrollTop,
            height: this.scroller.clientHeight,
            rowHeight: this.rowHeight,
            count: this.count,
        });
        this.before.style.height = `${first * this.rowHeight}px`;
        this.after.style.height = `${(this.count - last) * this.rowHeight}px`;
        for (const [index, row] of this.rows)
            if (index < first || index >= last) {
                if (row.contains(document.activeElement))
                    this.scroller.focus({ preventScroll: true });
                row.remove();
                this.rows.delete(index);
            }
        // Rows that stay are not moved: they would lose the focus.
        let next = this.after;
        for (let index = last - 1; index >= first; index--) {
            if (!this.rows.has(index)) {
                this.rows.set(index, this.render(index));
                this.body.insertBefore(this.rows.get(index), next);
            }
            next = this.rows.get(index);
        }
    }
}
