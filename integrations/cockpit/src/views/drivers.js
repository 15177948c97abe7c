// The loaded kernel modules.
import { _ } from "../cockpit.js";
import { ListView } from "./list.js";

export class DriversView extends ListView {
    constructor(page) {
        super({
            ...page,
            list: "drivers",
            table: {
                id: "drivers-table",
                filterId: "drivers-filter",
                label: _("Drivers"),
                none: _("No drivers are loaded."),
                columns: [
                    {
                        property: "driver-name", title: _("Name"), text: row => row["driver-name"],
                        link: row => ["tree", `driver:${row["driver-name"]}`],
                    },
                    { property: "driver-version", title: _("Version"), text: row => row["driver-version"] },
                    { property: "description", title: _("Purpose"), text: row => row.description },
                ],
            },
        });
    }
}
