// Makes docs/reader.png, the picture of the page script in README, of what script/site left in build/site.
import { fileURLToPath } from "node:url";
import { openPage } from "../tests/browser/browsers.mjs";

const page = await openPage("chromium");
await page.resize(900, 740);
await page.goto(new URL("../build/site/pagemeld/Manual/INTEGRATION.html?pagemeld=missing%20module", import.meta.url).href);
await page.until("document.querySelector('#pagemeld mark') && document.querySelector('#pagemeld nav li')");
await page.screenshot(fileURLToPath(new URL("../docs/reader.png", import.meta.url)));
await page.close();
