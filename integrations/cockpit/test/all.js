// Runs all tests in one process; one for each file takes many times as long.
import { readdirSync } from "node:fs";

for (const file of readdirSync(new URL(".", import.meta.url)).sort())
    if (file.endsWith(".test.js"))
        await import(`./${file}`);
