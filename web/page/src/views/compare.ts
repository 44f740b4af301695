import { h, section, table, type Cell } from '../dom.js';
import { differencesBetween } from '../logic/compare.js';
import { durationText, measureName } from '../logic/text.js';
import type { Model } from '../model.js';
import { allOf, distributionChart, distributionOf } from './distribution.js';
import { shareBar } from './verdict.js';

/** Two recordings beside each other: what differs, in words, figures and distributions. */
export function compareView(before: Model, after: Model): HTMLElement {
    const [one, other] = [before.figures, after.figures];
    const names = [one, other].map((each, i) => `${['before', 'after'][i]!}: ${each.head.recording}`);
    const rows: Cell[][] = one.measures.flatMap((measure) => {
        const match = other.measures.find((each) => each.name === measure.name && each.system === measure.system);
        const name = measureName(measure, one.measures);
        return [measure, ...(match ? [match] : [])].map((each, i): Cell[] => [`${name} ${['before', 'after'][i]!}`, shareBar(each),
            each.quantiles ? `${each.quantiles.p5} · ${each.quantiles.p50} · ${each.quantiles.p95} ${each.unit}` : '–']);
    });
    const counts = [['Duration', (i: number) => durationText([one, other][i]!.head.ticks * [one, other][i]!.head.interval)],
        ['Cell changes', (i: number) => String([one, other][i]!.head.cellChanges)],
        ['Ping-pongs', (i: number) => String([one, other][i]!.head.pingPongs)],
        ['Gaps', (i: number) => String([one, other][i]!.head.gaps)]] as const;
    const charts = h('div', { class: 'small-charts' });
    for (const measure of one.measures) {
        const match = other.measures.find((each) => each.name === measure.name && each.system === measure.system);
        const place = h('div');
        charts.append(place);
        if (!match) continue;
        void Promise.all([allOf(before, measure), allOf(after, match)]).then(([first, second]) => {
            place.replaceChildren(distributionChart(measureName(measure, one.measures), measure.unit, [
                distributionOf(first, 'before'), distributionOf(second, 'after')]));
        });
    }
    return section('compare', 'Before and after', h('p', {}, names.join(' · ')),
        h('ul', {}, ...differencesBetween(one, other).map((sentence) => h('li', {}, sentence))),
        table('Levels before and after', ['Level', 'Shares of time', '5 · 50 · 95 %'], rows),
        table('Counts before and after', ['What', '#Before', '#After'], counts.map(([name, value]) => [name, value(0), value(1)])), charts);
}
