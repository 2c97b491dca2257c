// Drives a headless Chromium over a pipe: no port is opened, and the browser ends with this program.
import { spawn } from "node:child_process";
import { existsSync, mkdtempSync, rmSync } from "node:fs";
import { tmpdir } from "node:os";
import path from "node:path";

export const program = ["/usr/bin/chromium", "/usr/bin/chromium-browser"].find(existsSync);

const flags = ["--headless", "--remote-debugging-pipe", "--disable-gpu", "--disable-quic", "--no-first-run",
    "--disable-background-networking", "--disable-component-update", "--disable-sync"];

// What a key is called in the browser's protocol, where that differs from its name.
const keyCodes = { Enter: [13, "\r"], Escape: [27], Tab: [9], ArrowUp: [38], ArrowDown: [40], "/": [191, "/"] };

// One page in a browser and a profile of its own. Collects the errors and the requests of the page.
export class Page {
    errors = [];
    requests = [];
    #profile = mkdtempSync(path.join(tmpdir(), "pagemeld-chromium-"));
    #waiting = new Map(); // for the answer with a number, or for an event
    #lastId = 0;
    #session;
    #browser;

    static async open() {
        const page = new Page();
        const ownFlags = [`--user-data-dir=${page.#profile}`, ...(process.getuid() === 0 ? ["--no-sandbox"] : [])];
        page.#browser = spawn(program, [...flags, ...ownFlags], { stdio: ["ignore", "ignore", "ignore", "pipe", "pipe"] });
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

    // The value of a function in the page, given the arguments.
    async evaluate(callee, ...args) {
        const expression = `(${callee})(...${JSON.stringify(args)})`;
        const { result, exceptionDetails } = await this.ask("Runtime.evaluate",
            { expression, awaitPromise: true, returnByValue: true, userGesture: true });
        if (exceptionDetails) {
            throw new Error(exceptionDetails.exception?.description ?? exceptionDetails.text);
        }
        return result.value;
    }

    // Waits until a function in the page returns something true, and returns it.
    async until(callee, ...args) {
        for (const end = Date.now() + 10000; Date.now() < end; ) {
            const value = await this.evaluate(callee, ...args);
            if (value) {
                return value;
            }
            await new Promise((resolve) => setTimeout(resolve, 20));
        }
        throw new Error(`never true: ${callee} ${JSON.stringify(args)}`);
    }

    async press(key, modifiers = 0) {
        const [windowsVirtualKeyCode, text] = keyCodes[key];
        const params = { key, code: key, windowsVirtualKeyCode, modifiers, text };
        await this.ask("Input.dispatchKeyEvent", { type: text && !modifiers ? "keyDown" : "rawKeyDown", ...params });
        await this.ask("Input.dispatchKeyEvent", { ...params, type: "keyUp" });
    }

    type(text) {
        return this.ask("Input.insertText", { text });
    }

    async picture() {
        return Buffer.from((await this.ask("Page.captureScreenshot")).data, "base64");
    }

    // A window of a width, in CSS pixels, for a reader who likes it light or dark.
    async resize(width, height, scheme = "light", scale = 1) {
        await this.ask("Emulation.setDeviceMetricsOverride", { width, height, deviceScaleFactor: scale, mobile: false });
        await this.ask("Emulation.setEmulatedMedia", { features: [{ name: "prefers-color-scheme", value: scheme }] });
    }
}
