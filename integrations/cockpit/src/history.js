/** Figures over time. If there are too many, every second one is dropped, and fewer are kept from then on. */
export class History {
    constructor(most = 600) {
        Object.assign(this, { most, samples: [], every: 1, taken: 0 });
    }

    /** A sample has the time in seconds and the figures by name. */
    add(sample) {
        if (this.taken++ % this.every !== 0)
            return;
        this.samples.push(sample);
        if (this.samples.length > this.most) {
            this.samples = this.samples.filter((_, i) => i % 2 === 0);
            this.every *= 2;
            this.taken = 1;
        }
    }
}

/** Returns the points of an SVG polyline through the samples. The last sample is at the right edge. */
export function pointsOf(samples, name, { width, height, most }) {
    const known = samples.filter(sample => Number.isFinite(sample[name]));
    if (known.length === 0 || most <= 0)
        return [];
    const first = known[0].time;
    const span = known[known.length - 1].time - first;
    const level = span > 0 ? known : [{ ...known[0], time: first - 1 }, known[0]];
    return level.map(sample => ({
        x: round(span > 0 ? (sample.time - first) / span * width : (sample.time - first + 1) * width),
        y: round(height - Math.min(1, sample[name] / most) * height),
    }));
}

function round(number) {
    return Math.round(number * 100) / 100;
}
