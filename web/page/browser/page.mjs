// A page in Chromium, watched for anything that a clean page does not do, and what pallax makes.
import assert from 'node:assert/strict';
import { execFileSync, spawn } from 'node:child_process';
import { mkdtempSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { createRequire } from 'node:module';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { pathToFileURL } from 'node:url';
import { chromium } from 'playwright-core';

export const folder = mkdtempSync(join(tmpdir(), 'pallax-page-'));
process.on('exit', () => rmSync(folder, { recursive: true, force: true }));

const env = { ...process.env, HOME: folder, XDG_CONFIG_HOME: folder, XDG_RUNTIME_DIR: folder, XDG_STATE_HOME: folder, TZ: 'UTC' };

/** Runs pallax with a home of its own and returns what it prints. */
export function pallax(...words) {
    return execFileSync(process.env.PALLAX, words, { encoding: 'utf8', maxBuffer: 1 << 30, env });
}

const running = new Set();
process.on('exit', () => running.forEach((child) => child.kill('SIGKILL')));

/** Starts pallax and waits until it has said this. */
function start(words, said) {
    const child = spawn(process.env.PALLAX, words, { env, stdio: ['ignore', 'pipe', 'pipe'] });
    running.add(child);
    child.on('exit', () => running.delete(child));
    let output = '';
    return new Promise((resolve, reject) => {
        const look = (text) => {
            output += text;
            const found = said.exec(output);
            if (found) resolve({ child, said: found[0] });
        };
        child.stdout.on('data', look);
        child.stderr.on('data', look);
        child.on('exit', () => reject(new Error(`pallax ${words.join(' ')} has ended: ${output}`)));
    });
}

/** `pallax web` with its link. */
export async function serve(...words) {
    const started = await start(['web', ...words], /^http\S+/m);
    return { ...started, link: started.said, origin: new URL(started.said).origin };
}

/** A service with a name, once it answers. */
export async function serveService(name, ...words) {
    const child = spawn(process.env.PALLAX, ['service', '--name', name, ...words], { env, stdio: 'ignore' });
    running.add(child);
    child.on('exit', () => running.delete(child));
    while (!pallax('service', '--list').split('\n').includes(name)) await new Promise((done) => { setTimeout(done, 20); });
    return { child };
}

/** Ends what was started, and waits for that. */
export function ended({ child }, signal = 'SIGINT') {
    return new Promise((resolve) => {
        child.on('exit', resolve);
        child.kill(signal);
    });
}

export const file = (name) => join(folder, name);

/** A recording of one message of the object stream, as XML. */
export function writeMessage(name, xml) {
    const bytes = Buffer.from(`<?xml version="1.0"?><plist version="1.0">${xml}</plist>`);
    const head = Buffer.alloc(24 + 16);
    head.writeUInt32LE(0xa1b2c3d4, 0);
    head.writeUInt16LE(2, 4);
    head.writeUInt16LE(4, 6);
    head.writeUInt32LE(65535, 16);
    head.writeUInt32LE(147, 20);
    head.writeUInt32LE(1700000000, 24);
    head.writeUInt32LE(bytes.length, 32);
    head.writeUInt32LE(bytes.length, 36);
    writeFileSync(file(name), Buffer.concat([head, bytes]));
    return file(name);
}

/** A report with this name, made of recordings and options. */
export function report(name, ...words) {
    pallax('report', ...words, '-o', file(name));
    return pathToFileURL(file(name)).href;
}

/** Chromium's sandbox refuses to work for root. */
export function launch(...flags) {
    return chromium.launch({ executablePath: process.env.CHROMIUM, chromiumSandbox: process.getuid() !== 0, args: flags });
}

// Runs in the page before its own scripts.
function watchPolicy() {
    document.addEventListener('securitypolicyviolation', (event) =>
        globalThis.reportViolation(`${event.effectiveDirective} blocked ${event.blockedURI}`));
}

/** The page, ready, and the problems that it has had so far. */
export async function open(browser, url, { width = 1440, height = 900, ...context } = {}) {
    const page = await (await browser.newContext({ viewport: { width, height }, ...context })).newPage();
    const problems = [];
    page.on('console', (message) => message.type() === 'error' && problems.push(`console: ${message.text()}`));
    page.on('pageerror', (error) => problems.push(`uncaught: ${error.message}`));
    page.on('dialog', (dialog) => {
        problems.push(`dialog: ${dialog.message()}`);
        void dialog.dismiss();
    });
    page.on('requestfailed', (request) => problems.push(`failed: ${request.url()}`));
    page.on('response', (response) => response.status() >= 400 && problems.push(`${response.status()}: ${response.url()}`));
    page.on('request', (request) => {
        const isOwn = /^(data|blob):/.test(request.url()) || request.url().split(/[?#]/)[0].startsWith(url.split(/[?#]/)[0].replace(/[^/]*$/, ''));
        if (!isOwn) problems.push(`request elsewhere: ${request.url()}`);
    });
    await page.exposeFunction('reportViolation', (text) => problems.push(`policy: ${text}`));
    await page.addInitScript(watchPolicy);
    await page.goto(url);
    await page.waitForSelector('html[data-ready]', { state: 'attached', timeout: 60000 });
    return { page, problems };
}

/** Findings of axe-core that are serious. */
export async function seriousFindings(page) {
    const source = readFileSync(createRequire(import.meta.url).resolve('axe-core/axe.min.js'), 'utf8');
    await page.evaluate(source);
    const { violations } = await page.evaluate(() => globalThis.axe.run());
    return violations.filter((each) => ['serious', 'critical'].includes(each.impact))
        .map((each) => `${each.id}: ${each.nodes.slice(0, 3).map((node) => node.html.slice(0, 120)).join(' | ')}`);
}

/** The leaves of a display as decode prints it: "Section/Key" to text. */
export function leavesOf(value, path = [], leaves = new Map()) {
    if (value !== null && typeof value === 'object') {
        for (const [key, each] of Object.entries(value)) leavesOf(each, [...path, key], leaves);
    } else if (value !== null) {
        leaves.set(path.join('/'), String(value));
    }
    return leaves;
}

/** The state table of a page: "Section/Key" to text. */
export async function shownState(page, time) {
    await page.evaluate((at) => globalThis.pallaxModels[0].look(at), time);
    await page.waitForSelector(`#state-table[data-time="${time}"]`);
    return new Map(await page.$$eval('#state-table tr[data-path]', (rows) =>
        rows.map((row) => [row.dataset.path, row.querySelector('td').firstChild.textContent])));
}

/** Numbers from 0 to 1 that are the same in each run. */
export function randomNumbers(seed) {
    let state = seed;
    return () => {
        state = (Math.imul(state, 1664525) + 1013904223) >>> 0;
        return state / 2 ** 32;
    };
}

export function assertClean(problems) {
    assert.deepEqual(problems, []);
}
