import assert from 'node:assert/strict';
import { statSync, writeFileSync } from 'node:fs';
import { after, before, test } from 'node:test';
import { assertClean, file, launch, leavesOf, open, pallax, randomNumbers, report, seriousFindings, shownState, writeMessage } from './page.mjs';

let browser;
let hour;
before(async () => {
    browser = await launch();
    pallax('simulate', 'lte', '--seconds', '3600', '-o', file('hour.pcap'));
    hour = report('hour.html', file('hour.pcap'));
});
after(() => browser.close());

test('a report is clean at 1440 and 360 pixels, light and dark, and nothing is wider than the window', async () => {
    for (const [width, colorScheme] of [[1440, 'light'], [360, 'light'], [1440, 'dark'], [360, 'dark']]) {
        const { page, problems } = await open(browser, hour, { width, colorScheme });
        assert.equal(await page.locator('h1').textContent(), 'Drive of 2023-11-14, 22:13:22 to 23:13:20 UTC');
        assert.ok(await page.evaluate(() => document.scrollingElement.scrollWidth <= innerWidth), `wider than ${width}`);
        assert.equal(await page.locator('.plot canvas').count(), 3);
        if ((width === 360) === (colorScheme === 'dark')) assert.deepEqual(await seriousFindings(page), [], `${width} ${colorScheme}`);
        assertClean(problems);
        await page.context().close();
    }
});

test('an hour of LTE at every tick has at most 1 MB', () => {
    const size = statSync(file('hour.html')).size;
    console.log(`an hour of LTE: ${size} bytes`);
    assert.ok(size <= 1_000_000);
});

test('the state at twenty random instants is what decode shows', async () => {
    pallax('mask', file('hour.pcap'), '-o', file('masked.pcap'));
    const [ticks, maskedTicks] = ['hour.pcap', 'masked.pcap'].map((name) => pallax('decode', '--every', 'tick', file(name)).trim().split('\n'));
    const { page, problems } = await open(browser, hour);
    const random = randomNumbers(20);
    for (let i = 0; i < 20; ++i) {
        const tick = Math.floor(random() * ticks.length);
        const { time, display } = JSON.parse(ticks[tick]);
        const expected = leavesOf(display);
        const masked = leavesOf(JSON.parse(maskedTicks[tick]).display);
        for (const [path, text] of masked) if (text !== expected.get(path)) expected.set(path, 'left out');
        assert.ok(expected.size > 30 && [...expected.values()].includes('left out'));
        assert.deepEqual(await shownState(page, Date.parse(time) / 1000), expected, time);
    }
    assertClean(problems);
    await page.context().close();
});

test('the levels at twenty random instants are those that decode shows', async () => {
    const name = 'lte.serving_cell_measurements.measured_rsrp';
    const { page } = await open(browser, hour);
    const random = randomNumbers(21);
    const { from, to } = JSON.parse(pallax('report', '--json', file('hour.pcap'))).head;
    let compared = 0;
    for (let i = 0; i < 20; ++i) {
        const time = from + 2 * Math.floor((random() * (to - from)) / 2);
        const state = await shownState(page, time);
        const levels = [state.get('Serving Cell Measurements/Measured RSRP'),
            state.get('Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP')].map((text) => text && Number.parseFloat(text));
        await page.waitForTimeout(20);
        const shown = Number.parseFloat(await page.locator('.reading').first().textContent());
        assert.ok(levels.includes(shown), `${name} at ${time}: ${shown} is none of ${levels}`);
        ++compared;
    }
    assert.equal(compared, 20);
    await page.context().close();
});

test('the keyboard looks at ticks, zooms and shows all', async () => {
    const { page, problems } = await open(browser, hour);
    const model = () => page.evaluate(() => { const { from, to, cursor } = globalThis.pallaxModels[0]; return { from, to, cursor }; });
    const start = await model();
    await page.locator('.area').focus();
    await page.keyboard.press('ArrowLeft');
    assert.equal((await model()).cursor, start.cursor - 2);
    assert.equal(await page.locator('#state-table caption').textContent(), 'State at 2023-11-14 23:13:18 UTC');
    await page.keyboard.press('+');
    const zoomed = await model();
    assert.ok(Math.abs((zoomed.to - zoomed.from) / (start.to - start.from) - 0.5) < 0.01);
    await page.waitForTimeout(100);
    assert.equal((await model()).cursor, start.cursor - 2, 'a zoom does not move the cursor');
    await page.keyboard.press('0');
    assert.deepEqual([(await model()).from, (await model()).to], [start.from, start.to]);
    await page.keyboard.press('Home');
    assert.equal((await model()).cursor, start.from);
    assertClean(problems);
    await page.context().close();
});

test('dragging zooms all curves, and a verdict leads to its worst minute', async () => {
    const { page } = await open(browser, hour);
    const plot = await page.locator('.plot .u-over').first().boundingBox();
    await page.mouse.move(plot.x + 0.25 * plot.width, plot.y + 40);
    const pointed = await page.evaluate(() => globalThis.pallaxModels[0].cursor);
    assert.ok(Math.abs(pointed - 1700000002 - 3598 / 4) < 20, `${pointed}`);
    await page.mouse.down();
    await page.mouse.move(plot.x + 0.5 * plot.width, plot.y + 40, { steps: 4 });
    await page.mouse.up();
    const size = await page.evaluate(() => globalThis.pallaxModels[0].to - globalThis.pallaxModels[0].from);
    assert.ok(Math.abs(size - 3598 / 4) < 20, `${size} s`);
    await page.getByTitle(/worst minute of RSRP/).click();
    const { measures } = JSON.parse(pallax('report', '--json', file('hour.pcap')));
    assert.equal(await page.evaluate(() => globalThis.pallaxModels[0].cursor), measures[0].worstStretch.from);
    await page.context().close();
});

test('contexts are told without what identifies a person', async () => {
    const { page } = await open(browser, hour);
    const rows = await page.locator('#contexts tbody tr').allTextContents();
    assert.equal(rows.length, 2);
    assert.match(rows[0], /^context 1there1/);
    assert.match(rows[1], /^context 2there\d\d/);
    await page.locator('#contexts tbody tr').nth(1).getByRole('button').click();
    const { contexts } = JSON.parse(pallax('report', '--json', file('hour.pcap')));
    assert.equal(await page.evaluate(() => globalThis.pallaxModels[0].cursor), contexts[1].spans[0].from);
    await page.context().close();
});

test('events are filtered by kind and words, and lead to their instant', async () => {
    const { page } = await open(browser, hour);
    await page.getByLabel('Kind').selectOption('ping-pong');
    const rows = page.locator('ol.events li');
    assert.equal(await rows.count(), JSON.parse(pallax('report', '--json', file('hour.pcap'))).head.pingPongs);
    await page.getByLabel('Filter by words').fill('no such words');
    assert.equal(await rows.count(), 0);
    await page.getByLabel('Filter by words').fill('');
    await rows.first().getByRole('button').click();
    const events = JSON.parse(pallax('report', '--json', file('hour.pcap'))).events;
    assert.equal(await page.evaluate(() => globalThis.pallaxModels[0].cursor), events.find((event) => event.kind === 'ping-pong').time);
    await page.context().close();
});

/** A recording of messages of the object stream, as XML, each with its second. */
function writeMessages(name, messages) {
    const head = Buffer.alloc(24);
    head.writeUInt32LE(0xa1b2c3d4, 0);
    head.writeUInt16LE(2, 4);
    head.writeUInt16LE(4, 6);
    head.writeUInt32LE(65535, 16);
    head.writeUInt32LE(147, 20);
    const packets = messages.flatMap(([second, xml]) => {
        const bytes = Buffer.from(`<?xml version="1.0"?><plist version="1.0">${xml}</plist>`);
        const before = Buffer.alloc(16);
        before.writeUInt32LE(second, 0);
        before.writeUInt32LE(bytes.length, 8);
        before.writeUInt32LE(bytes.length, 12);
        return [before, bytes];
    });
    writeFileSync(file(name), Buffer.concat([head, ...packets]));
    return file(name);
}

test('where the clock was set back, each stretch of time can be shown', async () => {
    const message = (second, bsic) => [second, `<dict><key>Serving Cell</key><dict><key>ARFCN</key><string>62</string><key>BSIC</key>` +
        `<string>${bsic}</string><key>Rx Level</key><string>-${bsic.replace(',', '')} dBm</string></dict></dict>`];
    const begin = 1700000000;
    const seconds = Array.from({ length: 30 }, (_, i) => 2 * i);
    const recording = writeMessages('back.pcap', [...seconds.map((i) => message(begin + i, '7,1')),
        ...seconds.slice(0, 10).map((i) => message(begin + 10 + i, '9,2'))]);
    const { page, problems } = await open(browser, report('back.html', recording));
    const choice = page.getByLabel('Stretch of time');
    const caption = page.locator('#state-table caption');
    const reading = page.locator('.reading').first();
    assert.deepEqual(await choice.locator('option').allTextContents(), ['1 of 2: 2023-11-14 22:13:22 to 2023-11-14 22:14:20',
        '2 of 2: 2023-11-14 22:13:32 to 2023-11-14 22:13:50']);
    assert.equal(await reading.textContent(), '-71 dBm');
    await choice.selectOption('1');
    await page.waitForFunction(() => document.querySelector('.reading').textContent === '-92 dBm');
    assert.equal(await caption.textContent(), 'State at 2023-11-14 22:13:50 UTC');
    assert.ok(await page.getByText('It begins 48 s before the end of stretch 1.').isVisible());
    assert.deepEqual(await page.evaluate(() => {
        const model = globalThis.pallaxModels[0];
        return model.inStretch(model.figures.cells).map((stay) => stay.cell);
    }), ['BSIC 9,2']);
    await choice.selectOption('0');
    await page.locator('ol.events li', { hasText: 'time-step' }).getByRole('button').click();
    assert.equal(await choice.inputValue(), '1');
    await page.waitForFunction(() => document.querySelector('.reading').textContent === '–');
    assert.equal(await page.locator('h1').textContent(), 'Drive of 2023-11-14, 22:13:22 to 22:14:20 UTC');
    assertClean(problems);
    await page.context().close();
});

test('texts of a modem that look like markup are shown as texts', async () => {
    const evil = '<script>alert(1)</script><img src=x onerror=alert(2)>';
    const escaped = evil.replaceAll('<', '&lt;').replaceAll('>', '&gt;');
    const recording = writeMessages('evil.pcap', [[1700000000, `<dict><key>Network</key><dict><key>Name</key><string>${escaped}</string>` +
        `<key>MCC</key><string>262</string><key>MNC</key><string>42</string></dict><key>${escaped}</key><string>${escaped}</string>` +
        `<key>Serving Cell</key><dict><key>ARFCN</key><string>${escaped}</string></dict></dict>`]]);
    const url = report('evil.html', recording, '--with-identities', '--title', evil, '--label', evil);
    const { page, problems } = await open(browser, url);
    assert.equal(await page.locator('h1').textContent(), evil);
    assert.equal(await page.title(), evil);
    assert.ok((await page.locator('.lead').textContent()).startsWith(`${evil} · IFX · `));
    const state = await shownState(page, 1700000002);
    assert.equal(state.get(evil), evil);
    assert.equal(await page.locator('img').count(), 0);
    assert.equal(await page.locator('#page script').count(), 0);
    assert.ok(await page.getByText('This page holds what identifies a person.').isVisible());
    assertClean(problems);
    await page.context().close();
});

test('hostile names and numbers leave the page readable', async () => {
    const huge = 'N'.repeat(2000);
    const neighbours = Array.from({ length: 550 }, (_, i) => `<dict><key>ARFCN</key><string>${i}</string><key>Rx Level</key><string>-90 dBm</string></dict>`);
    const message = (i, level, name) => [1700000000 + 2 * i, `<dict><key>Network</key><dict><key>Name</key><string>${name}</string>` +
        `<key>MCC</key><string>262</string><key>MNC</key><string>42</string></dict><key>${name}</key><string>${name}</string>` +
        `<key>Serving Cell</key><dict><key>ARFCN</key><string>62</string><key>BSIC</key><string>${name}</string><key>Rx Level</key>` +
        `<string>${level}</string></dict><key>Neighbour Cells</key><array>${neighbours.join('')}</array></dict>`];
    const levels = ['nan dBm', 'inf dBm', '1e308 dBm', '-1e308 dBm', '', '-70 dBm'];
    const recording = writeMessages('hostile.pcap', levels.map((level, i) => message(i, level, [huge, 'a\u202eb\u2066'][i % 2])));
    const url = report('hostile.html', recording);
    for (const width of [1440, 360]) {
        const { page, problems } = await open(browser, url, { width });
        assert.ok(await page.evaluate(() => document.scrollingElement.scrollWidth <= innerWidth), `wider than ${width}`);
        assert.equal((await shownState(page, 1700000012)).get('a\\u202Eb\\u2066'), 'a\\u202Eb\\u2066');
        assert.ok(await page.getByText('Only the first 512 neighbouring cells are in the report.').isVisible());
        assertClean(problems);
        await page.context().close();
    }
});

test('every technology, two recordings and a track are clean', async () => {
    const points = Array.from({ length: 60 }, (_, i) => `<trkpt lat="${50 + 0.001 * i}" lon="${7 + 0.0015 * Math.sin(i / 9)}"><time>` +
        `${new Date(1000 * (1700000000 + 2 * i)).toISOString()}</time></trkpt>`);
    writeFileSync(file('way.gpx'), `<gpx><trk><trkseg>${points.join('')}</trkseg></trk></gpx>`);
    for (const technology of ['ifx', 'gsm', 'cdma', 'lte', 'utran']) {
        for (const seed of ['1', '2']) {
            pallax('simulate', technology, '--seconds', '300', '--seed', seed, '-o', file(`${technology}-${seed}.pcap`));
        }
        const url = report('two.html', file(`${technology}-1.pcap`), file(`${technology}-2.pcap`), '--track', file('way.gpx'));
        const { page, problems } = await open(browser, url);
        assert.ok(await page.locator('#compare li').count() > 0, technology);
        assert.ok(await page.locator('.track line').count() > 50, technology);
        await page.locator('.track line').nth(30).click({ force: true });
        assert.equal(await page.evaluate(() => globalThis.pallaxModels[0].cursor), 1700000060, technology);
        if (technology === 'gsm') assert.deepEqual(await seriousFindings(page), [], technology);
        await page.locator('.chooser input').nth(1).check();
        await page.waitForFunction(() => document.querySelector('.lead').textContent.includes('-2.pcap'));
        assertClean(problems);
        await page.context().close();
    }
});

test('a report prints on A4 pages, in light colours', async () => {
    const { page, problems } = await open(browser, hour, { colorScheme: 'dark' });
    const pdf = await page.pdf({ preferCSSPageSize: true });
    const text = pdf.toString('latin1');
    assert.match(text, /\/MediaBox \[0 0 59[45][.\d]* 84[12][.\d]*\]/);
    await page.emulateMedia({ media: 'print' });
    assert.equal(await page.evaluate(() => getComputedStyle(document.documentElement).backgroundColor), 'rgb(255, 255, 255)');
    assertClean(problems);
    await page.context().close();
});

test('a day of a million values opens and zooms', async () => {
    pallax('simulate', 'lte', '--seconds', '86400', '--rate', '12', '-o', file('day.pcap'));
    const url = report('day.html', file('day.pcap'));
    const { head, measures, neighbours } = JSON.parse(pallax('report', '--json', file('day.pcap')));
    const { page, problems } = await open(browser, url);
    const drawn = await page.evaluate(() => performance.getEntriesByName('drawn')[0].startTime);
    const zoom = await page.evaluate(async () => {
        const model = globalThis.pallaxModels[0];
        const begin = performance.now();
        model.zoom(0.5);
        await new Promise((done) => requestAnimationFrame(() => requestAnimationFrame(done)));
        const half = performance.now();
        model.showAll();
        await new Promise((done) => requestAnimationFrame(() => requestAnimationFrame(done)));
        return [half - begin, performance.now() - half];
    });
    console.log(`a day: ${head.ticks} ticks of ${measures.length + neighbours.length} series, ` +
        `${statSync(file('day.html')).size} bytes, drawn after ${Math.round(drawn)} ms, zoomed in ${zoom.map(Math.round).join(' and ')} ms`);
    assert.ok(head.ticks * (measures.length + neighbours.length) > 1_000_000);
    assertClean(problems);
    await page.context().close();
});
