// Drives a headless Chromium over a pipe: no port is opened, and the browser ends with this program.
import assert from "node:assert/strict";
import { spawn } from "node:child_process";
import { mkdtempSync, rmSync } from "node:fs";
import { tmpdir } from "node:os";

const flags = ["--headless", "--remote-debugging-pipe", "--disable-gpu", "--disable-quic", "--no-first-run",
    "--disable-background-networking", "--disable-component-update", "--disable-sync",
    ...(process.getuid() === 0 ? ["--no-sandbox"] : [])];
const keys = { Tab: [9], Enter: [13, "\r"], Escape: [27], ArrowUp: [38], ArrowDown: [40], "/": [191, "/"] };

// One page, in a browser with a profile of its own. Collects the errors and the requests since it went somewhere.
export class Page {
    #profile = mkdtempSync(`${tmpdir()}/pagemeld-chromium-`);
    #browser = spawn("chromium", [...flags, `--user-data-dir=${this.#profile}`],
        { stdio: ["ignore", "ignore", "ignore", "pipe", "pipe"] });
    #waiting = new Map(); // who waits for the answer with a number, or for an event
    #lastId = 0;
    #session;

    static async open() {
        const page = new Page();
        page.#read();
        const { targetId } = await page.ask("Target.createTarget", { url: "about:blank" });
        page.#session = (await page.ask("Target.attachToTarget", { targetId, flatten: true })).sessionId;
        await Promise.all(["Page", "Runtime", "Network", "Log"].map((domain) => page.ask(`${domain}.enable`)));
        return page;
    }

    async close() {
        this.#browser.stdio[3].end();
        await new Promise((resolve) => this.#browser.once("close", resolve));
        rmSync(this.#profile, { recursive: true, force: true, maxRetries: 5 });
    }

    async #read() {
        let rest = "";
        for await (const text of this.#browser.stdio[4].setEncoding("utf8")) {
            const messages = (rest + text).split("\0");
            rest = messages.pop();
            messages.forEach((message) => this.#take(JSON.parse(message)));
        }
    }

    #take({ id, method, params, result, error }) {
        const { exceptionDetails, entry, request } = params ?? {};
        exceptionDetails && this.errors.push(exceptionDetails.exception?.description ?? exceptionDetails.text);
        entry?.level === "error" && this.errors.push(`${entry.text} ${entry.url}`);
        method === "Network.requestWillBeSent" && this.requests.push(request.url);
        const { resolve, reject } = this.#waiting.get(id ?? method) ?? {};
        this.#waiting.delete(id ?? method);
        error ? reject(new Error(error.message)) : resolve?.(result ?? params);
    }

    #next = (key) => new Promise((resolve, reject) => this.#waiting.set(key, { resolve, reject }));

    ask(method, params = {}) {
        const message = { id: ++this.#lastId, method, params, sessionId: this.#session };
        this.#browser.stdio[3].write(JSON.stringify(message) + "\0");
        return this.#next(message.id);
    }

    async goto(url) {
        [this.errors, this.requests] = [[], []];
        await Promise.all([this.#next("Page.loadEventFired"), this.ask("Page.navigate", { url })]);
    }

    async evaluate(expression) {
        const { result, exceptionDetails: fault } = await this.ask("Runtime.evaluate",
            { expression, awaitPromise: true, returnByValue: true, userGesture: true });
        assert(!fault, `${expression}: ${fault?.exception?.description}`);
        return result.value;
    }

    // Waits until an expression is true, also across pages.
    async until(expression) {
        for (const end = Date.now() + 10000; !(await this.evaluate(expression).catch(() => false));) {
            assert(Date.now() < end, `never true: ${expression}`);
        }
    }

    async press(key, modifiers = 0) {
        const params = { key, code: key, windowsVirtualKeyCode: keys[key][0], text: keys[key][1], modifiers };
        await this.ask("Input.dispatchKeyEvent", { type: "keyDown", ...params });
        await this.ask("Input.dispatchKeyEvent", { type: "keyUp", ...params });
    }
}
