// All groups as a table; one group's page when the address names it.
import { countNames } from "../account-rows.js";
import { button } from "../button.js";
import { _ } from "../cockpit.js";
import { tasks } from "../tasks.js";
import { GroupPage } from "./group.js";
import { ListView } from "./list.js";
import { Pair } from "./pair.js";

export class GroupsView extends Pair {
    constructor(page) {
        super(new ListView({
            ...page,
            list: "groups",
            table: {
                id: "groups-table",
                filterId: "groups-filter",
                label: _("Groups"),
                none: _("No groups."),
                columns: [
                    {
                        property: "group-name", title: _("Name"), text: row => row["group-name"],
                        link: row => ["groups", row["group-name"]],
                    },
                    {
                        property: "group-id", title: _("GID"), text: row => row["group-id"], order: "number",
                        width: "narrow",
                    },
                    {
                        property: "members", title: _("Members"), width: "large",
                        text: row => row.members === "" ? "" : `${countNames(row.members)}: ${row.members}`,
                    },
                ],
            },
            buttons: [button(_("Add group"), () => page.preview(tasks.groupAdd), {
                id: "group-add", look: "primary", changes: true,
            })],
        }), new GroupPage(page));
    }
}
