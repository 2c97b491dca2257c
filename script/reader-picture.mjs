// Makes docs/reader.png, the picture of the page script in README, of what script/demo left in build/demo.
import { writeFileSync } from "node:fs";
import { Page } from "../tests/browser/chromium.mjs";

const page = await Page.open();
await page.ask("Emulation.setDeviceMetricsOverride", { width: 900, height: 740, deviceScaleFactor: 1, mobile: false });
await page.goto(new URL("../build/demo/charts/Manual/tide-rose.html?pagemeld=first%20re", import.meta.url).href);
await page.until("document.querySelector('#pagemeld mark') && document.querySelector('#pagemeld nav li')");
const { data } = await page.ask("Page.captureScreenshot");
writeFileSync(new URL("../docs/reader.png", import.meta.url), Buffer.from(data, "base64"));
await page.close();
