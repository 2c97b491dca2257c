// One page in a real browser: Chromium and Firefox through puppeteer-core, WebKitGTK through its WebDriver.
// All have the same few methods, and a profile of their own; close() ends the browser. A browser is named by its program.
import assert from "node:assert/strict";
import { spawn } from "node:child_process";
import { existsSync, writeFileSync } from "node:fs";
import { createServer } from "node:net";
import path from "node:path";
import { setTimeout as delay } from "node:timers/promises";
import puppeteer from "puppeteer-core";

const webKit = "WebKitWebDriver";
const programOf = (name) => process.env.PATH.split(":").map((directory) => path.join(directory, name)).find(existsSync);

export const openPage = (program) => (program === webKit ? WebKitPage : PuppeteerPage).open(programOf(program));

class Page {
    errors = []; // of the page, since it went somewhere

    // Waits until an expression is true, also across pages.
    async until(expression) {
        for (const end = Date.now() + 30000; !(await this.evaluate(`Boolean(${expression})`).catch(() => false));) {
            assert(Date.now() < end, `never true: ${expression}`);
            await delay(20);
        }
    }
}

class PuppeteerPage extends Page {
    static async open(executablePath) {
        const page = new PuppeteerPage();
        const browser = executablePath.includes("firefox") ? "firefox" : "chrome";
        const args = browser === "chrome" && process.getuid() === 0 ? ["--no-sandbox"] : [];
        page.browser = await puppeteer.launch({ browser, executablePath, args, defaultViewport: null });
        await page.renew();
        return page;
    }

    // Goes on in a new tab, without the history of the one before. It has the focus, which the first one lacks in Firefox.
    async renew() {
        const old = this.tab;
        this.tab = await this.browser.newPage();
        this.tab.on("pageerror", (error) => { this.errors.push(String(error)); });
        this.tab.on("console", (message) => {
            if (message.type() === "error") {
                this.errors.push(message.text());
            }
        });
        await old?.close();
    }

    async goto(url) {
        this.errors = [];
        await this.tab.goto(url);
    }

    close() { return this.browser.close(); }
    evaluate(code) { return this.tab.evaluate(code); }
    press(key) { return this.tab.keyboard.press(key); }
    click(x, y) { return this.tab.mouse.click(x, y); }
    resize(width, height) { return this.tab.setViewport({ width, height }); }
    screenshot(file) { return this.tab.screenshot({ path: file }); }
}

const keys = { Tab: "\uE004", Enter: "\uE007", Escape: "\uE00C", ArrowLeft: "\uE012", ArrowUp: "\uE013",
    ArrowRight: "\uE014", ArrowDown: "\uE015", PageDown: "\uE00F" };
const writeConsole = "--enable-write-console-messages-to-stdout=true";

async function findFreePort() {
    const server = createServer().listen(0, "127.0.0.1");
    await new Promise((resolve) => server.once("listening", resolve));
    const { port } = server.address();
    await new Promise((resolve) => server.close(resolve));
    return port;
}

// Needs a display, for example of xvfb-run.
class WebKitPage extends Page {
    static async open(executablePath) {
        const page = new WebKitPage();
        const port = await findFreePort();
        page.driver = spawn(executablePath, [`--port=${port}`], { stdio: ["ignore", "pipe", "ignore"] });
        page.driver.stdout.setEncoding("utf8").on("data", (text) => page.errors.push(...text.match(/^CONSOLE.*ERROR.*/gm) ?? []));
        page.address = `http://127.0.0.1:${port}/session`;
        const libraries = "/usr/lib/x86_64-linux-gnu";
        const binary = `${libraries}/webkit2gtk-4.1/MiniBrowser`;
        const options = { "webkitgtk:browserOptions": { binary, args: ["--automation", writeConsole] } };
        const { sessionId } = await page.#start({ capabilities: { alwaysMatch: options } });
        page.address += `/${sessionId}`;
        return page;
    }

    // The driver listens a moment after it was started.
    async #start(capabilities) {
        for (const end = Date.now() + 10000; ; await delay(50)) {
            try {
                return await this.ask("", capabilities);
            } catch (error) {
                assert(Date.now() < end, error);
            }
        }
    }

    // What is asked of a page while it is left may never be answered.
    async ask(command, body) {
        const options = { method: body ? "POST" : "GET", body: body ? JSON.stringify(body) : null };
        const response = await fetch(this.address + command, { ...options, signal: AbortSignal.timeout(15000) });
        const { value } = await response.json();
        assert(response.ok, value?.message);
        return value;
    }

    async goto(url) {
        this.errors = [];
        await this.ask("/url", { url });
    }

    async renew() {} // Back is no trouble here

    async close() {
        await fetch(this.address, { method: "DELETE" });
        this.driver.kill();
    }

    evaluate(code) {
        const script = `const done = arguments[0]; Promise.resolve(${code}).then(done, (error) => done(String(error)))`;
        return this.ask("/execute/async", { script, args: [] });
    }

    press(key) {
        const value = keys[key] ?? key;
        return this.#act("key", {}, [{ type: "keyDown", value }, { type: "keyUp", value }]);
    }

    click(x, y) {
        return this.#act("pointer", { parameters: { pointerType: "mouse" } }, [{ type: "pointerMove", x, y },
            { type: "pointerDown", button: 0 }, { type: "pointerUp", button: 0 }]);
    }

    #act(type, parameters, actions) {
        return this.ask("/actions", { actions: [{ type, id: type, ...parameters, actions }] });
    }

    async resize(width, height) {
        await this.ask("/window/rect", { width, height });
    }

    async screenshot(file) {
        writeFileSync(file, Buffer.from(await this.ask("/screenshot"), "base64"));
    }
}
