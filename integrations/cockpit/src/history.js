/** Figures over a session. When there are too many, every other one is left out, and fewer are taken. */
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

/** The points of a line over the samples, as an SVG polyline has them. The last sample is at the right. */
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
