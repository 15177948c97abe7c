// Control characters, and those that reorder or hide text, could make a name look like another.
const hidden = new RegExp(
    "[\\u0000-\\u0008\\u000b-\\u001f\\u007f-\\u009f\\u00ad\\u061c\\u200b-\\u200f\\u2028-\\u202e" +
    "\\u2060-\\u206f\\ufeff\\ufff9-\\ufffb\\u{e0000}-\\u{e0fff}]", "gu");

/** Returns the text with such characters as escapes; tabs and line ends stay. */
export function visible(text) {
    return text.replace(hidden, character => {
        const code = character.codePointAt(0);
        const [letter, length] = code < 0x100 ? ["x", 2] : code < 0x10000 ? ["u", 4] : ["U", 8];
        return `\\${letter}${code.toString(16).padStart(length, "0")}`;
    });
}
