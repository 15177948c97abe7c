import assert from "node:assert/strict";
import { test } from "node:test";
import { countNames, dayText, daysText, expiryText, factText } from "../src/account-rows.js";

test("expiryText shows the last possible day as never", () => {
    assert.equal(expiryText("2038-01-19 00:00:00", "never"), "never");
    assert.equal(expiryText("2030-02-01 00:00:00", "never"), "2030-02-01");
    assert.equal(expiryText("-", "never"), "-");
});

test("dayText leaves the time of day out", () => {
    assert.equal(dayText("2030-02-01 00:00:00"), "2030-02-01");
});

test("daysText shows 99999 days as no limit", () => {
    assert.equal(daysText("99999", "no limit"), "no limit");
    assert.equal(daysText("90", "no limit"), "90");
    assert.equal(daysText("-", "no limit"), "-");
});

test("countNames counts members", () => {
    assert.deepEqual(["", "-", "anna", "anna,ben"].map(countNames), [0, 0, 1, 2]);
});

const words = { yes: "yes", no: "no", unknown: "unknown" };

test("factText has a word for missing values", () => {
    assert.equal(factText({ day: "2030-01-01" }, "day", "never", words), "2030-01-01");
    assert.equal(factText({ day: null }, "day", "never", words), "never");
    assert.equal(factText({ days: 0 }, "days", "none", words), 0);
    assert.deepEqual([true, false].map(must => factText({ must }, "must", "", words)), ["yes", "no"]);
});

test("factText knows nothing without the password's entry", () => {
    for (const value of [null, false])
        assert.equal(factText({ value, unknown: "Permission denied" }, "value", "never", words), "unknown");
});
