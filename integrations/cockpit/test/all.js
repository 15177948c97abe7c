// Runs all tests in one process; one process for each file takes much longer.
import { readdirSync } from "node:fs";

for (const file of readdirSync(new URL(".", import.meta.url)).sort())
    if (file.endsWith(".test.js"))
        await import(`./${file}`);
