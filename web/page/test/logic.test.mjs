import assert from 'node:assert/strict';
import { test } from 'node:test';

const load = (name) => import(`${process.env.PALLAX_PAGE_LOGIC}/${name}.js`);
const { denseOf, thinned, valueAt, valueNear } = await load('changes');
const text = await load('text');
const { cumulativeOf, histogramOf, inCell } = await load('spread');
const { differencesBetween } = await load('compare');
const { chartedNeighbours } = await load('neighbours');
const { placeAt, placedOf, scaleLength } = await load('track');

const changes = { ticks: Uint32Array.of(2, 5), values: Float32Array.of(-90, NaN) };

test('a value holds until it changes', () => {
    assert.deepEqual([0, 1, 2, 4].map((tick) => valueAt(changes, tick)), [0, 0, -90, -90]);
    assert.ok(Number.isNaN(valueAt(changes, 5)));
    assert.deepEqual([...denseOf(changes, 7)].map(String), ['NaN', 'NaN', '-90', '-90', '-90', 'NaN', 'NaN']);
});

test('few ticks are drawn as they are, with a hole where time is missing', () => {
    const times = Float64Array.of(0, 2, 4, 60, 62);
    const drawn = thinned(times, [Float32Array.of(1, 2, NaN, 4, 5)], 0, 5, 100);
    assert.deepEqual(drawn.times, [0, 2, 4, 4.001, 60, 62]);
    assert.deepEqual(drawn.values, [[1, 2, null, null, 4, 5]]);
});

test('of many ticks no peak is lost', () => {
    const count = 10000;
    const times = Float64Array.from({ length: count }, (_, i) => 2 * i);
    const values = Float32Array.from({ length: count }, (_, i) => (i === 7777 ? -140 : i === 3333 ? -44 : -90));
    const drawn = thinned(times, [values, Float32Array.from(times)], 0, count, 200);
    assert.ok(drawn.times.length <= 210, `${drawn.times.length} points`);
    assert.equal(Math.min(...drawn.values[0]), -140);
    assert.equal(Math.max(...drawn.values[0]), -44);
    assert.ok(drawn.times.every((time, i) => i === 0 || drawn.times[i - 1] < time), 'times ascend');
    assert.deepEqual(drawn.values[1].slice(0, 2), [0, drawn.times[1]], 'the earlier extreme comes first');
});

test('a value is not known for longer than ten seconds', () => {
    const drawn = { times: [0, 2], values: [[-90, -91]] };
    assert.equal(valueNear(drawn, 0, -1), null);
    assert.equal(valueNear(drawn, 0, 1), -90);
    assert.equal(valueNear(drawn, 0, 12), -91);
    assert.equal(valueNear(drawn, 0, 12.5), null);
});

test('times are ISO, of 24 hours, in UTC', () => {
    assert.equal(text.timeText(1700000000.9), '2023-11-14 22:13:20');
    assert.equal(text.titleOf({ title: '', from: 1700000000, to: 1700001800, stretches: [] }), 'Drive of 2023-11-14, 22:13:20 to 22:43:20 UTC');
    assert.equal(text.titleOf({ title: '', from: 1700000000, to: 1700010000, stretches: [] }),
        'Drive of 2023-11-14, 22:13:20 to 2023-11-15 01:00:00 UTC');
    assert.equal(text.titleOf({ title: '', from: 1700000000, to: 1699990060,
        stretches: [{ from: 1700000000, to: 1700000060 }, { from: 1699990000, to: 1699990060 }] }),
    'Drive of 2023-11-14, 19:26:40 to 22:14:20 UTC', 'the clock was set back');
    assert.equal(text.titleOf({ title: 'Mine', from: 0, to: 0, stretches: [] }), 'Mine');
    assert.deepEqual([48, 200, 3900].map(text.durationText), ['48 s', '3 min 20 s', '1 h 05 min']);
});

test('what turns the direction of a text, or controls a terminal, stands as an escape', () => {
    assert.equal(text.printable('a\u202eb\u2069\u0007\u0085\n\t\u00e9 <b>'), 'a\\u202Eb\\u2069\\x07\\u0085\n\t\u00e9 <b>');
});

test('shares do not hide what is small', () => {
    assert.deepEqual([0, 0.004, 0.31, 0.996, 1].map(text.shareText), ['0 %', '0.4 %', '31 %', '99.6 %', '100 %']);
});

test('grades follow the borders in both directions', () => {
    const larger = [{ grade: 'good', value: -90 }, { grade: 'poor', value: -110 }];
    assert.deepEqual([-80, -90, -91, -110, -111].map((value) => text.gradeOf(value, larger)), ['good', 'good', 'poor', 'poor', 'none']);
    const smaller = [{ grade: 'good', value: 2 }, { grade: 'poor', value: 5 }];
    assert.deepEqual([1, 2, 3, 6].map((value) => text.gradeOf(value, smaller)), ['good', 'good', 'poor', 'none']);
    assert.equal(text.gradeOf(NaN, larger), '');
    assert.equal(text.gradeOf(-90, []), '');
    assert.equal(text.bandWords(larger), 'good from -90, poor from -110');
});

test('a place of the display is judged by its path', () => {
    const profile = { borders: { rsrp: [{ grade: 'good', value: -90 }] }, graded: [{ path: '/List/*/RSRP', measure: 'rsrp' }] };
    assert.equal(text.bordersAt(['List', '3', 'RSRP'], profile).length, 1);
    assert.equal(text.bordersAt(['List', '3', 'PCI'], profile).length, 0);
    assert.equal(text.bordersAt(['List', 'RSRP'], profile).length, 0);
});

test('a histogram counts seconds, and a hole counts ten of them', () => {
    const bins = histogramOf([{ times: [0, 2, 4, 100], values: [[-90.5, -90.25, null, -88]] }], 10);
    assert.deepEqual(bins.map((bin) => [bin.from, bin.seconds]), [[-91, 4], [-90, 0], [-89, 0], [-88, 2]]);
    assert.deepEqual(cumulativeOf(bins).map((share) => share.toFixed(2)), ['0.67', '0.67', '0.67', '1.00']);
    assert.deepEqual(histogramOf([{ times: [0], values: [[null]] }], 10), []);
    assert.deepEqual(histogramOf([{ times: [0, 60], values: [[-90, null]] }], 10).map((bin) => bin.seconds), [10]);
    const stretch = { times: [0, 2], values: [[-90, -90]] };
    assert.deepEqual(histogramOf([stretch, stretch], 10).map((bin) => bin.seconds), [8], 'each stretch counts');
});

test('values in one cell are those of its stays', () => {
    const stays = [{ cell: 'PCI 1', from: 0, to: 2 }, { cell: 'PCI 2', from: 2, to: 6 }, { cell: 'PCI 1', from: 6, to: 9 }];
    const drawn = { times: [0, 4, 8, 12], values: [[1, 2, 3, 4]] };
    assert.deepEqual(inCell(drawn, stays, 'PCI 1'), { times: drawn.times, values: [[1, null, 3, null]] });
});

const figures = (p50, poor, more = {}) => ({
    head: { ticks: 1800, interval: 2, cellChanges: 5, pingPongs: 0, ...more.head },
    measures: [{ name: 'RSRP', system: 'LTE', unit: 'dBm', worst: -140, best: -44, quantiles: { p50 },
        shares: [{ grade: 'good', share: 1 - poor }, { grade: 'poor', share: poor }] }],
    cells: more.cells ?? [], events: more.events ?? [],
});

test('two recordings are compared in words', () => {
    assert.deepEqual(differencesBetween(figures(-95, 0.25), figures(-90, 0.05)), [
        'RSRP is better by 5 dB: the median went from -95 to -90 dBm.',
        'RSRP was poor or worse for 25 % of the time before and 5.0 % after.',
        'There were 5 cell changes in 1 h 00 min before and 5 cell changes in 1 h 00 min after.']);
    const after = figures(-95.5, 0, { head: { cellChanges: 1 }, cells: [{ cell: 'PCI 9' }], events: [{ kind: 'service-lost' }] });
    assert.deepEqual(differencesBetween(figures(-95, 0, { cells: [{ cell: 'PCI 8' }] }), after), [
        'RSRP is about the same: the median is -95 before and -95.5 dBm after.',
        'There were 5 cell changes in 1 h 00 min before and 1 cell change in 1 h 00 min after.',
        'There were 0 losses of service in 1 h 00 min before and 1 loss of service in 1 h 00 min after.',
        'Served only before: PCI 8.', 'Served only after: PCI 9.']);
});

test('a track is drawn to scale, north up', () => {
    const { points, width, height } = placedOf([[0, 60, 7], [10, 60.01, 7.02]]);
    assert.ok(Math.abs(height - 1113.2) < 0.1);
    assert.ok(Math.abs(width - 1113.2) < 1, 'a degree of longitude is half as long at 60 degrees');
    assert.ok(points[0].y > points[1].y);
    const middle = placeAt(points, 5);
    assert.ok(Math.abs(middle.x - width / 2) < 1);
    assert.equal(placeAt(points, -1), null);
    assert.equal(placeAt(points, 11), null);
    assert.deepEqual([10, 900, 3000, 16000].map(scaleLength), [2, 200, 1000, 5000]);
});

test('of the neighbours of each system and measure six have a curve', () => {
    const cell = (id, system, seconds = 2) => ({ id, system, measure: 'rsrp', unit: 'dBm', seconds });
    const all = [cell(1, 'LTE', 0), ...[2, 3, 4, 5, 6, 7, 8].map((id) => cell(id, 'LTE')), cell(9, 'GSM')];
    assert.deepEqual(chartedNeighbours(all).map((group) => group.map((each) => each.id)), [[2, 3, 4, 5, 6, 7], [9]]);
});

const { patched } = await load('patch');

test('a patch makes the later value, and shares what does not change', () => {
    const before = { head: { ticks: 1 }, events: [{ kind: 'a' }, { kind: 'b' }], states: [{ name: 'RRC', spans: [{ text: 'idle', to: 2 }] }], cells: [] };
    const after = patched(before, { members: {
        head: { members: { ticks: { value: 2 } } },
        events: { items: { drop: 1, size: 1, at: {}, add: [{ kind: 'c' }] } },
        states: { items: { drop: 0, size: 1, at: { 0: { members: { spans: { items: { drop: 0, size: 1,
            at: { 0: { members: { to: { value: 4 } } } }, add: [{ text: 'connected', to: 6 }] } } } } }, add: [] } },
        notes: { value: ['new'] },
    } });
    assert.deepEqual(after, { head: { ticks: 2 }, events: [{ kind: 'b' }, { kind: 'c' }],
        states: [{ name: 'RRC', spans: [{ text: 'idle', to: 4 }, { text: 'connected', to: 6 }] }], cells: [], notes: ['new'] });
    assert.equal(after.cells, before.cells);
    assert.equal(before.head.ticks, 1);
    assert.deepEqual(patched([1, 2, 3], { items: { drop: 0, size: 1, at: {}, add: [] } }), [1]);
    assert.equal(patched({ a: 1 }, { value: null }), null);
});
