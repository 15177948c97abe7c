// Control characters, and those that reorder or hide text, would let a name pose as another.
const hidden = /[\u0000-\u0008\u000b-\u001f\u007f-\u009f\u00ad\u061c\u200b-\u200f\u2028-\u202e\u2060-\u2069\ufeff]/g;

/** The text with characters that do not show as escapes; tabs and line ends stay. */
export function visible(text) {
    return text.replace(hidden, character => {
        const code = character.charCodeAt(0);
        return code < 0x100 ? `\\x${code.toString(16).padStart(2, "0")}` : `\\u${code.toString(16).padStart(4, "0")}`;
    });
}
