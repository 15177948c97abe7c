// The library that Cockpit serves as base1/cockpit.js.
export const cockpit = window.cockpit;
export const _ = cockpit.gettext;
export const format = cockpit.format;
