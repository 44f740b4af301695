// The live page: real servers, a real browser.
import assert from 'node:assert/strict';
import { createServer } from 'node:http';
import { after, before, test } from 'node:test';
import { assertClean, ended, file, launch, leavesOf, open, pallax, randomNumbers, seriousFindings, serve, serveService, shownState, writeMessage } from './page.mjs';

let browser;
before(async () => { browser = await launch(); });
after(() => browser.close());

const ticksOf = (page) => page.evaluate(() => globalThis.pallaxModels[0].figures.head.ticks);
const waitForTicks = (page, least) => page.waitForFunction((most) => globalThis.pallaxModels[0].figures.head.ticks >= most, least);
const modelOf = (page) => page.evaluate(() => {
    const { cursor, isFollowing, figures } = globalThis.pallaxModels[0];
    return { cursor, isFollowing, to: figures.head.to };
});

test('follows a simulated service, clean at 1440 and 360 pixels', async () => {
    const service = await serveService('car', '--simulate', 'lte', '--speed', '20');
    const web = await serve('--connect', 'car');
    for (const width of [1440, 360]) {
        const { page, problems } = await open(browser, web.link, { width });
        assert.equal(new URL(page.url()).search, '', 'no token stays in the address');
        const before = await ticksOf(page);
        await waitForTicks(page, before + 10);
        assert.equal(await page.locator('.live').textContent(), 'Hold Live');
        assert.equal((await modelOf(page)).cursor, (await modelOf(page)).to);
        assert.ok(await page.evaluate(() => document.scrollingElement.scrollWidth <= innerWidth), `wider than ${width}`);
        assert.equal(await page.locator('.plot canvas').count(), 3);
        assert.ok(await page.locator('.lane').count() >= 4);
        if (width === 360) assert.deepEqual(await seriousFindings(page), []);
        if (process.env.PALLAX_PICTURES) await page.screenshot({ path: `${process.env.PALLAX_PICTURES}/live-${width}.png` });
        assertClean(problems);
        await page.context().close();
    }
    await Promise.all([ended(web), ended(service)]);
});

test('holds, goes back and follows again', async () => {
    const web = await serve('demo', 'lte', '--speed', '20');
    const { page, problems } = await open(browser, web.link);
    await waitForTicks(page, 10);
    await page.keyboard.press(' ');
    const held = await modelOf(page);
    assert.equal(held.isFollowing, false);
    await page.waitForFunction(() => /^Follow Held at \d\d:\d\d:\d\d UTC, [1-9]\d* new ticks$/.test(document.querySelector('.live').textContent));
    assert.equal((await modelOf(page)).to, held.to, 'the page stays as it is');
    await page.locator('.area').focus();
    await page.keyboard.press('ArrowLeft');
    const back = held.to - 2;
    await page.waitForSelector(`#state-table[data-time="${back}"]`);
    assert.equal((await modelOf(page)).cursor, back);
    await page.getByRole('button', { name: 'Follow' }).click();
    await page.waitForFunction((time) => globalThis.pallaxModels[0].cursor > time, held.to);
    assert.equal((await modelOf(page)).isFollowing, true);
    const plot = await page.locator('.plot .u-over').first().boundingBox();
    await page.mouse.move(plot.x + 20, plot.y + 20);
    assert.equal((await modelOf(page)).isFollowing, false, 'pointing at the past holds');
    await page.mouse.move(5, 5);
    assert.equal((await modelOf(page)).isFollowing, true, 'until the pointer leaves');
    assertClean(problems);
    await page.context().close();
    await ended(web);
});

test('survives the death of the service, and its return', async () => {
    const service = await serveService('van', '--simulate', 'lte', '--speed', '20');
    const web = await serve('--connect', 'van');
    const { page, problems } = await open(browser, web.link);
    await waitForTicks(page, 5);
    await ended(service, 'SIGKILL');
    await page.waitForFunction(() => document.querySelector('.live [role=status]').textContent !== '');
    const { to } = await modelOf(page);
    const again = await serveService('van', '--simulate', 'lte', '--seed', '9', '--speed', '20');
    await page.waitForFunction(() => document.querySelector('.live [role=status]').textContent === '');
    await page.waitForFunction((time) => globalThis.pallaxModels[0].figures.head.to !== time, to);
    // The simulation begins at the same time again: another stretch of time, which is shown at once.
    assert.deepEqual(await page.evaluate(() => {
        const model = globalThis.pallaxModels[0];
        return [model.stretch, model.figures.head.stretches.length, [0, 1].every((each) => model.figures.cells.some((stay) => stay.stretch === each))];
    }), [1, 2, true]);
    await page.getByLabel('Stretch of time').selectOption('0');
    assert.equal((await modelOf(page)).isFollowing, false, 'an earlier stretch is held');
    await page.getByRole('button', { name: 'Follow' }).click();
    assert.equal(await page.getByLabel('Stretch of time').inputValue(), '1');
    await page.waitForFunction(() => Number(document.querySelector('#state-table').dataset.time) === globalThis.pallaxModels[0].cursor);
    assertClean(problems);
    await page.context().close();
    await Promise.all([ended(web), ended(again)]);
});

test('says that the server has ended', async () => {
    const web = await serve('demo', 'gsm', '--speed', '20');
    const { page } = await open(browser, web.link);
    await ended(web);
    await page.waitForFunction(() => document.querySelector('.live').textContent.endsWith('No connection to pallax web'));
    await page.context().close();
});

test('values at twenty random instants are those of decode', async () => {
    pallax('simulate', 'lte', '--seconds', '600', '-o', file('drive.pcap'));
    const ticks = pallax('decode', '--every', 'tick', file('drive.pcap')).trim().split('\n').map((line) => JSON.parse(line));
    const web = await serve(file('drive.pcap'), '--speed', 'max', '--with-identities');
    const { page, problems } = await open(browser, web.link);
    await waitForTicks(page, ticks.length);
    await page.waitForFunction(() => document.querySelector('.live [role=status]').textContent === 'End of the recording');
    const random = randomNumbers(22);
    for (let i = 0; i < 20; ++i) {
        const { time, display } = ticks[Math.floor(random() * ticks.length)];
        const state = await shownState(page, Date.parse(time) / 1000);
        const expected = leavesOf(display);
        assert.deepEqual(state, expected, time);
        const levels = [expected.get('Serving Cell Measurements/Measured RSRP'),
            expected.get('Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP')].map((text) => text && Number.parseFloat(text));
        const shown = () => page.locator('.reading').first().textContent().then(Number.parseFloat);
        for (let tries = 0; tries < 50 && !levels.includes(await shown()); ++tries) await page.waitForTimeout(10);
        assert.ok(levels.includes(await shown()), `RSRP at ${time}: ${await shown()} is none of ${levels}`);
    }
    const { head, measures } = JSON.parse(pallax('report', '--json', file('drive.pcap')));
    const own = await page.evaluate(() => globalThis.pallaxModels[0].figures);
    assert.deepEqual([own.head.packets, own.head.ticks, own.head.cellChanges], [head.packets, head.ticks, head.cellChanges]);
    assert.deepEqual(own.measures.map((each) => each.quantiles), measures.map((each) => each.quantiles));
    assertClean(problems);
    await page.context().close();
    await ended(web);
});

test('texts of a modem that look like markup are shown as texts', async () => {
    const evil = '<script>alert(1)</script><img src=x onerror=alert(2)>';
    const escaped = evil.replaceAll('<', '&lt;').replaceAll('>', '&gt;');
    const recording = writeMessage('<script>alert(3)<!--.pcap', `<dict><key>Network</key><dict><key>Name</key><string>${escaped}</string>` +
        `<key>MCC</key><string>262</string><key>MNC</key><string>42</string></dict><key>${escaped}</key><string>${escaped}</string>` +
        `<key>Serving Cell</key><dict><key>ARFCN</key><string>${escaped}</string></dict></dict>`);
    const web = await serve(recording, '--speed', 'max', '--with-identities');
    const { page, problems } = await open(browser, web.link);
    await page.waitForSelector('#state-table[data-time]');
    const state = new Map(await page.$$eval('#state-table tr[data-path]', (rows) => rows.map((row) => [row.dataset.path, row.querySelector('td').firstChild.textContent])));
    assert.equal(state.get(evil), evil);
    assert.ok((await page.locator('.lead').textContent()).includes('<script>alert(3)<!--.pcap'));
    assert.equal(await page.locator('img').count(), 0);
    assert.equal(await page.locator('#page script').count(), 0);
    assertClean(problems);
    await page.context().close();
    await ended(web);
});

/** What a page of another origin gets out of the server, whose cookie the browser has. */
async function plunder(base) {
    const got = [];
    const note = (way) => (result) => got.push(`${way}: ${result}`);
    for (const path of ['/', '/api/figures', '/api/state?at=1', '/metrics']) {
        for (const mode of ['cors', 'no-cors']) {
            await fetch(base + path, { mode, credentials: 'include' })
                .then(async (answer) => answer.type === 'opaque' ? null : note(`${mode} ${path}`)(await answer.text()), () => null);
        }
    }
    await new Promise((done) => {
        const events = new EventSource(`${base}/api/events`, { withCredentials: true });
        events.addEventListener('figures', () => { note('events')('came'); done(); });
        events.addEventListener('error', () => { events.close(); done(); });
    });
    for (const [name, attribute] of [['script', 'src'], ['img', 'src'], ['iframe', 'src']]) {
        await new Promise((done) => {
            const element = document.createElement(name);
            element.addEventListener('load', () => {
                // A frame loads the browser's own error page, which is none of ours.
                if (name !== 'iframe') note(name)('loaded');
                done();
            });
            element.addEventListener('error', () => done());
            element[attribute] = `${base}/api/figures`;
            document.body.append(element);
        });
    }
    const frames = [...document.querySelectorAll('iframe')].map((frame) => {
        try { return frame.contentDocument?.body.textContent ?? ''; } catch { return ''; }
    });
    for (const text of frames) if (text) note('frame')(text);
    return got;
}

test('a page of another origin gets nothing', async () => {
    const web = await serve('demo', 'lte', '--speed', '20', '--metrics');
    const { page } = await open(browser, web.link);
    const asked = [];
    page.context().on('request', (request) => asked.push(request.url()));
    const attacker = createServer((_request, response) => response.setHeader('Content-Type', 'text/html').end('<!doctype html><body>'));
    await new Promise((done) => { attacker.listen(0, '127.0.0.1', done); });
    for (const host of ['127.0.0.1', 'localhost']) {
        const evil = await page.context().newPage();
        await evil.goto(`http://${host}:${attacker.address().port}/`);
        assert.deepEqual(await evil.evaluate(plunder, web.origin), [], host);
        await evil.close();
    }
    for (const path of ['/metrics', '/api/figures', '/api/events']) assert.ok(asked.includes(web.origin + path), path);
    const before = await ticksOf(page);
    await waitForTicks(page, before + 2);
    attacker.close();
    await page.context().close();
    await ended(web);
});

test('a wrong token and a rebound name get nothing, even with the link', async () => {
    const web = await serve('demo', 'lte', '--speed', '20');
    const { hostname, port, search } = new URL(web.link);
    assert.equal(hostname, '127.0.0.1');
    const rebound = await launch('--host-resolver-rules=MAP evil.example 127.0.0.1');
    const page = await (await rebound.newContext()).newPage();
    const answerTo = async (url) => {
        const response = await page.goto(url);
        return [response.status(), (await response.text()).trim()];
    };
    assert.deepEqual(await answerTo(`${web.origin}/?token=${'0'.repeat(32)}`), [403, 'Open the link that pallax web has printed.']);
    assert.deepEqual(await answerTo(`${web.origin}/`), [403, 'Open the link that pallax web has printed.']);
    assert.deepEqual(await answerTo(`http://evil.example:${port}/${search}`), [421, 'This is not the host of that name.']);
    assert.deepEqual(await page.context().cookies(), []);
    await rebound.close();
    await ended(web);
});
