// The changes that the page offers, as tables. Each is one command of mihost; mihost explains its fields
// as parameters of the method that the command calls.
import { _ } from "./cockpit.js";

// A field is an argument, or an option of that name. Its kind is "text", "number", "day" or "password".
const userName = { name: "user", label: () => _("User name"), parameter: "UserName", required: true };
const groupName = { name: "group", label: () => _("Group name"), parameter: "GroupName", required: true };
const ageing = [
    {
        name: "min-days", option: "--min-days", kind: "number", label: () => _("Minimum password age (days)"),
        parameter: "daysMustKeepPassword",
    },
    {
        name: "max-days", option: "--max-days", kind: "number", label: () => _("Maximum password age (days)"),
        parameter: "daysMustChangePasswordAfter",
    },
    {
        name: "warn-days", option: "--warn-days", kind: "number", label: () => _("Warning before expiry (days)"),
        parameter: "daysWarnBeforePasswordExpire",
    },
    {
        name: "inactive-days", option: "--inactive-days", kind: "number",
        label: () => _("Inactive after expiry (days)"), parameter: "daysExpireAfter",
    },
];
const password = {
    name: "password", kind: "password", label: () => _("Password"), parameter: "Password", required: true,
};

export const tasks = {
    userAdd: {
        title: () => _("Add user"),
        words: ["user", "add"],
        method: "UserAdd",
        fields: [
            userName,
            { name: "full-name", option: "--full-name", label: () => _("Full name"), parameter: "Comment" },
            { name: "home", option: "--home", label: () => _("Home directory"), parameter: "HomeDir" },
            { name: "shell", option: "--shell", label: () => _("Login shell"), parameter: "ScriptPath" },
            { ...password, required: false, option: "--password" },
            ...ageing,
            {
                name: "expires", option: "--expires", kind: "day", label: () => _("Account expires on"),
                parameter: "passwordExpirationDate",
            },
        ],
    },
    userSetName: {
        title: () => _("Change full name"),
        words: ["user", "set-name"],
        method: "UserSetFullName",
        fields: [userName, { name: "full-name", label: () => _("Full name"), parameter: "FullName" }],
    },
    userSetHome: {
        title: () => _("Move home directory"),
        words: ["user", "set-home"],
        method: "UserSetHomeDir",
        fields: [userName, { name: "home", label: () => _("Home directory"), parameter: "HomeDir", required: true }],
    },
    userSetShell: {
        title: () => _("Change login shell"),
        words: ["user", "set-shell"],
        method: "UserSetScriptPath",
        fields: [userName, { name: "shell", label: () => _("Login shell"), parameter: "ScriptPath", required: true }],
    },
    userSetPassword: {
        title: () => _("Set password"),
        words: ["user", "set-password"],
        method: "UserSetPassword",
        fields: [userName, password],
    },
    userExpire: {
        title: () => _("Set expiry date"),
        words: ["user", "expire"],
        method: "UserSetAttrib",
        fields: [userName, {
            name: "expires", kind: "day", label: () => _("Account expires on"), parameter: "passwordExpirationDate",
            absent: "never",
        }],
    },
    userAge: {
        title: () => _("Change password ageing"),
        words: ["user", "age"],
        method: "UserSetAttrib",
        fields: [userName, ...ageing],
    },
    userDelete: {
        title: () => _("Delete user"),
        words: ["user", "delete"],
        method: "UserDel",
        fields: [userName],
        danger: { label: () => _("Type the name of the user to delete it"), name: values => values.user },
    },
    groupAdd: {
        title: () => _("Add group"),
        words: ["group", "add"],
        method: "LocalGroupAdd",
        fields: [groupName],
    },
    groupDelete: {
        title: () => _("Delete group"),
        words: ["group", "delete"],
        method: "LocalGroupDel",
        fields: [groupName],
        danger: { label: () => _("Type the name of the group to delete it"), name: values => values.group },
    },
    groupAddMember: {
        title: () => _("Add user to group"),
        words: ["group", "add-member"],
        method: "LocalGroupAddUser",
        fields: [
            { ...groupName, parameter: "LocalGroupName" },
            { ...userName, parameter: "DomainAndMember" },
        ],
    },
    groupRemoveMember: {
        title: () => _("Remove user from group"),
        words: ["group", "remove-member"],
        method: "LocalGroupDelUser",
        fields: [
            { ...groupName, parameter: "LocalGroupName" },
            { ...userName, parameter: "DomainAndMember" },
        ],
    },
    clearLog: {
        title: () => _("Clear the log"),
        words: ["clear-log"],
        fields: [],
        danger: { label: () => _("Type the name of this machine to clear its log"), name: "machine" },
    },
    restart: {
        title: () => _("Restart the machine"),
        words: ["power", "restart"],
        fields: [],
        danger: { label: () => _("Type the name of this machine to restart it"), name: "machine" },
    },
    halt: {
        title: () => _("Halt the machine"),
        words: ["power", "halt"],
        fields: [],
        danger: { label: () => _("Type the name of this machine to halt it"), name: "machine" },
    },
};
