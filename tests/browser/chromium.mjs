// Drives a headless Chromium over a pipe: no port is opened, and the browser ends with this program.
import { spawn } from "node:child_process";
import { existsSync, mkdtempSync, rmSync } from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";

export const program = ["/usr/bin/chromium", "/usr/bin/chromium-browser"].find(existsSync);

const flags = ["--headless", "--remote-debugging-pipe", "--disable-gpu", "--disable-quic", "--no-first-run",
    "--disable-background-networking", "--disable-component-update", "--disable-sync",
    ...(process.getuid() === 0 ? ["--no-sandbox"] : [])];
const keyCodes = { Tab: 9, Enter: 13, Escape: 27, ArrowUp: 38, ArrowDown: 40, "/": 191 };
const keyTexts = { Enter: "\r", "/": "/" };

// One page, in a browser with a profile of its own. Collects the errors and the requests since it went somewhere.
export class Page {
    #profile = mkdtempSync(path.join(tmpdir(), "pagemeld-chromium-"));
    #browser = spawn(program, [...flags, `--user-data-dir=${this.#profile}`],
        { stdio: ["ignore", "ignore", "ignore", "pipe", "pipe"] });
    #waiting = new Map(); // who waits for the answer with a number, or for an event
    #lastId = 0;
    #session;

    static async open() {
        const page = new Page();
        page.#read(page.#browser.stdio[4].setEncoding("utf8"));
        const { targetId } = await page.ask("Target.createTarget", { url: "about:blank" });
        page.#session = (await page.ask("Target.attachToTarget", { targetId, flatten: true })).sessionId;
        for (const domain of ["Page", "Runtime", "Network", "Log"]) {
            await page.ask(`${domain}.enable`);
        }
        return page;
    }

    async close() {
        const ended = new Promise((resolve) => this.#browser.once("close", resolve));
        this.#browser.stdio[3].end();
        await ended;
        rmSync(this.#profile, { recursive: true, force: true, maxRetries: 5 });
    }

    async #read(stream) {
        let rest = "";
        for await (const text of stream) {
            const messages = (rest + text).split("\0");
            rest = messages.pop();
            messages.forEach((message) => this.#take(JSON.parse(message)));
        }
    }

    #take({ id, method, params, result, error }) {
        if (method === "Runtime.exceptionThrown") {
            this.errors.push(params.exceptionDetails.exception?.description ?? params.exceptionDetails.text);
        } else if (method === "Log.entryAdded" && params.entry.level === "error") {
            this.errors.push(`${params.entry.text} ${params.entry.url ?? ""}`);
        } else if (method === "Network.requestWillBeSent") {
            this.requests.push(params.request.url);
        }
        const { resolve, reject } = this.#waiting.get(id ?? method) ?? {};
        this.#waiting.delete(id ?? method);
        error ? reject(new Error(error.message)) : resolve?.(result ?? params);
    }

    #next(key) {
        return new Promise((resolve, reject) => this.#waiting.set(key, { resolve, reject }));
    }

    ask(method, params = {}) {
        const id = ++this.#lastId;
        this.#browser.stdio[3].write(JSON.stringify({ id, method, params, sessionId: this.#session }) + "\0");
        return this.#next(id);
    }

    async goto(url) {
        [this.errors, this.requests] = [[], []];
        const loaded = this.#next("Page.loadEventFired");
        await this.ask("Page.navigate", { url });
        await loaded;
    }

    // The value of an expression, or of a function with arguments, in the page.
    async evaluate(code, ...args) {
        const expression = typeof code === "string" ? code : `(${code})(...${JSON.stringify(args)})`;
        const { result, exceptionDetails: fault } = await this.ask("Runtime.evaluate",
            { expression, awaitPromise: true, returnByValue: true, userGesture: true });
        if (fault) {
            throw new Error(`${expression}: ${fault.exception?.description ?? fault.text}`);
        }
        return result.value;
    }

    // Waits for something true, also across pages.
    async until(code, ...args) {
        for (const end = Date.now() + 10000; Date.now() < end;) {
            if (await this.evaluate(code, ...args).catch(() => false)) {
                return;
            }
            await new Promise((resolve) => setTimeout(resolve, 10));
        }
        throw new Error(`never true: ${code} ${JSON.stringify(args)}`);
    }

    async press(key, modifiers = 0) {
        const params = { key, code: key, windowsVirtualKeyCode: keyCodes[key], modifiers, text: keyTexts[key] };
        await this.ask("Input.dispatchKeyEvent", { type: "keyDown", ...params });
        await this.ask("Input.dispatchKeyEvent", { ...params, type: "keyUp" });
    }

    async picture() {
        return Buffer.from((await this.ask("Page.captureScreenshot")).data, "base64");
    }

    // Gives the window a size in CSS pixels, and the reader a liking for light or dark.
    async setWindow(width, height, scheme = "light", deviceScaleFactor = 1) {
        await this.ask("Emulation.setDeviceMetricsOverride", { width, height, deviceScaleFactor, mobile: false });
        await this.ask("Emulation.setEmulatedMedia", { features: [{ name: "prefers-color-scheme", value: scheme }] });
    }
}
