import assert from "node:assert/strict";
import { readFileSync, readdirSync } from "node:fs";
import { test } from "node:test";
import gettext from "gettext-parser";
import { compile } from "../translation.js";

const folder = new URL("../", import.meta.url);
const header = "msgid \"\"\nmsgstr \"\"\n\"Language: de\\n\"\n\"Content-Type: text/plain; charset=UTF-8\\n\"\n\n";

function located(script) {
    let texts = null;
    new Function("cockpit", script)({ locale: given => { texts = given; } });
    return texts;
}

test("compile makes a script that passes the texts to Cockpit", () => {
    const texts = located(compile(`${header}msgid "Apply"\nmsgstr "Übernehmen \\"jetzt\\""\n`));
    assert.deepEqual(texts, {
        "": { "language": "de", "language-direction": "ltr" },
        "Apply": [null, "Übernehmen \"jetzt\""],
    });
});

test("compile leaves out what is not translated, or only guessed", () => {
    const texts = located(compile(`${header}msgid "Apply"\nmsgstr ""\n\n#, fuzzy\nmsgid "Halt"\nmsgstr "Halt!"\n`));
    assert.deepEqual(Object.keys(texts), [""]);
});

test("compile refuses a translation without a language", () => {
    assert.throws(() => compile("msgid \"Apply\"\nmsgstr \"x\"\n"), /language/);
});

test("the template has the texts of the sources, and no others", () => {
    const text = /\b_\(((?:"(?:[^"\\]|\\.)*"[\s+]*)+)\)/g;
    const wanted = new Set();
    for (const name of readdirSync(new URL("src/", folder), { recursive: true }).map(String))
        if (name.endsWith(".js")) {
            const source = readFileSync(new URL(`src/${name}`, folder), "utf8");
            const calls = [...source.matchAll(text)];
            assert.equal(calls.length, source.split(/\b_\(/).length - 1, `${name}: a text that is computed`);
            for (const [, call] of calls)
                wanted.add(JSON.parse(call.replace(/"\s*\+\s*"/g, "")));
        }
    const template = gettext.po.parse(readFileSync(new URL("po/mihost.pot", folder), "utf8"));
    const texts = new Set(Object.keys(template.translations[""]).filter(Boolean));
    assert.deepEqual([...texts].sort(), [...wanted].sort(), "run 'npm run pot'");
});
