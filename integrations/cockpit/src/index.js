import { App } from "./app.js";
import { cockpit } from "./cockpit.js";
import { followTheme } from "./theme.js";

followTheme();
cockpit.transport.wait(() => new App(document.body));
