// Translations: a .po file becomes the script that Cockpit serves as po.js to browsers of that language.
import gettext from "gettext-parser";

const rightToLeft = ["ar", "fa", "he", "ur"];

/** Returns the script for the text of a .po file, without the texts that are not translated. */
export function compile(po) {
    const { headers, translations } = gettext.po.parse(po);
    const language = headers?.Language;
    if (!language)
        throw new Error("a translation has to name its language");
    const texts = { "": { language, "language-direction": rightToLeft.includes(language) ? "rtl" : "ltr" } };
    for (const { msgid, msgstr, comments } of Object.values(translations[""]))
        if (msgid !== "" && msgstr[0] !== "" && !comments?.flag?.includes("fuzzy"))
            texts[msgid] = [null, msgstr[0]];
    return `cockpit.locale(${JSON.stringify(texts)});\n`;
}
