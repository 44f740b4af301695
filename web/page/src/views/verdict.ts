import { h, section, table, button, type Cell } from '../dom.js';
import { clockText, durationText, levelText, measureName, shareText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { Measure } from '../source.js';

/** The shares of a measure as a bar, with the words that say the same. */
export function shareBar(measure: Measure): HTMLElement {
    if (measure.shares.length === 0) return h('span', { class: 'quiet' }, 'not judged');
    const told = measure.shares.filter((each) => each.share > 0);
    const words = told.map((each) => `${each.grade} ${shareText(each.share)}`);
    const bar = h('span', { class: 'bar', 'aria-hidden': 'true' });
    for (const each of told) {
        const piece = h('span', { class: `grade-${each.grade}` });
        piece.style.flexGrow = String(each.share);
        bar.append(piece);
    }
    return h('span', { class: 'shares' }, bar, h('span', {}, words.join('  ·  ')));
}

function rowOf(model: Model, measure: Measure): Cell[] {
    const { quantiles: q, worstStretch: worst } = measure;
    const name = h('span', { title: measure.meaning }, measureName(measure, model.figures.measures));
    const link = worst
        ? button(`${clockText(worst.from)}, mean ${levelText(worst.mean, measure.unit)}`,
            `Show the worst minute of ${measure.name}, ${clockText(worst.from)}`,
            () => model.goTo(worst.from, worst.to, worst.stretch))
        : h('span', { class: 'quiet' }, 'less than a minute');
    return [name, shareBar(measure), q ? `${q.p5} · ${q.p50} · ${q.p95} ${measure.unit}` : '–',
        q ? `${q.least} to ${q.most} ${measure.unit}` : '–', durationText(measure.seconds), link];
}

export function verdictView(model: Model): HTMLElement {
    const place = h('div');
    const draw = (): void => {
        const { measures, head } = model.figures;
        place.replaceChildren(measures.length === 0
            ? h('p', {}, 'This recording has no levels of a serving cell.')
            : table(`Shares of time by the profile ${head.profile.name}`,
                ['Level', 'Shares of time', '5 · 50 · 95 %', 'Least to greatest', 'Known for', 'Worst minute'],
                measures.map((measure) => rowOf(model, measure))),
        h('p', { class: 'quiet' }, `Profile ${head.profile.name}: ${head.profile.source}.`));
    };
    draw();
    model.on('data', draw);
    return section('verdict', 'Verdict', place);
}
