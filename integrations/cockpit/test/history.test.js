import assert from "node:assert/strict";
import { test } from "node:test";
import { History, pointsOf } from "../src/history.js";

const size = { width: 100, height: 50, most: 10 };

test("History keeps few samples, evenly spread", () => {
    const history = new History(10);
    for (let time = 0; time < 1000; time++)
        history.add({ time });
    const times = history.samples.map(sample => sample.time);
    assert.ok(times.length <= 10 && times.length >= 5, String(times.length));
    assert.equal(times[0], 0);
    const steps = new Set(times.slice(1).map((time, i) => time - times[i]));
    assert.equal(steps.size, 1, [...steps].join());
});

test("pointsOf spreads samples by time, high values at the top", () => {
    const samples = [{ time: 0, n: 0 }, { time: 1, n: 5 }, { time: 4, n: 10 }];
    assert.deepEqual(pointsOf(samples, "n", size), [{ x: 0, y: 50 }, { x: 25, y: 25 }, { x: 100, y: 0 }]);
});

test("pointsOf draws one sample as a level line", () => {
    assert.deepEqual(pointsOf([{ time: 7, n: 5 }], "n", size), [{ x: 0, y: 25 }, { x: 100, y: 25 }]);
});

test("pointsOf stays within the picture", () => {
    assert.deepEqual(pointsOf([{ time: 0, n: 20 }, { time: 1 }, { time: 2, n: 5 }], "n", size),
        [{ x: 0, y: 0 }, { x: 100, y: 25 }]);
    assert.deepEqual(pointsOf([{ time: 0, n: 0 }], "n", { ...size, most: 0 }), []);
});
