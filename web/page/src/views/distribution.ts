import { seriesColour } from '../colours.js';
import { h, section, svg } from '../dom.js';
import { cumulativeOf, histogramOf, inCell, type Bin } from '../logic/spread.js';
import { hole } from '../logic/changes.js';
import { counted, measureName, shareText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { Drawn, Measure } from '../source.js';

const [width, height, left, bottom] = [460, 200, 40, 28];

const byNumber = new Intl.Collator('en', { numeric: true });

/** One recording's values of a measure. */
export interface Distribution {
    label: string;
    bins: Bin[];
}

/** Every reading of a measure, in each stretch: no more points than a day has ticks. */
export function allOf(model: Model, measure: Measure): Promise<Drawn[]> {
    const stretches = model.source.isLive ? [model.stretch] : model.figures.head.stretches.map((_, i) => i);
    return Promise.all(stretches.map((stretch) => model.source.series([measure.id], -Infinity, Infinity, 2_000_000, stretch)));
}

export function distributionOf(pieces: readonly Drawn[], label: string): Distribution {
    return { label, bins: histogramOf(pieces, hole) };
}

/** Histograms as bars, cumulative curves as lines; several lie over each other. */
export function distributionChart(title: string, unit: string, all: readonly Distribution[]): HTMLElement {
    const known = all.filter((each) => each.bins.length > 0);
    if (known.length === 0) return h('p', { class: 'quiet' }, `${title}: nothing was measured.`);
    const least = Math.min(...known.map((each) => each.bins[0]!.from));
    const most = Math.max(...known.map((each) => each.bins.at(-1)!.to));
    const shares = known.map((each) => {
        const total = each.bins.reduce((sum, bin) => sum + bin.seconds, 0);
        return each.bins.map((bin) => (total > 0 ? bin.seconds / total : 0));
    });
    const highest = Math.max(...shares.flat());
    const x = (value: number): number => left + ((value - least) / (most - least)) * (width - left - 8);
    const y = (share: number): number => 8 + (1 - share) * (height - bottom - 8);
    const picture = svg('svg', { viewBox: `0 0 ${width} ${height}`, role: 'img', 'aria-label': wordsOf(title, unit, known) });
    for (const share of [0, 0.25, 0.5, 0.75, 1]) {
        picture.append(svg('line', { x1: left, x2: width - 8, y1: y(share), y2: y(share), class: 'grid' }),
            svg('text', { x: left - 6, y: y(share) + 4, 'text-anchor': 'end' }, shareText(share)));
    }
    const step = [1, 2, 5, 10, 20, 50, 100, 200, 500, 1000].find((each) => (most - least) / each <= 8) ?? 5000;
    for (let value = Math.ceil(least / step) * step; value <= most; value += step) {
        picture.append(svg('text', { x: x(value), y: height - 8, 'text-anchor': 'middle' }, String(value)));
    }
    known.forEach(({ bins }, i) => {
        const colour = seriesColour(i);
        bins.forEach((bin, k) => {
            const share = shares[i]![k]! / highest;
            picture.append(svg('rect', { x: x(bin.from), width: Math.max(x(bin.to) - x(bin.from) - 1, 0.5), y: y(share),
                height: y(0) - y(share), fill: colour, 'fill-opacity': known.length > 1 ? 0.3 : 0.35 }));
        });
        const line = cumulativeOf(bins).map((share, k) => `${x(bins[k]!.to).toFixed(1)},${y(share).toFixed(1)}`);
        picture.append(svg('polyline', { points: [`${x(bins[0]!.from).toFixed(1)},${y(0).toFixed(1)}`, ...line].join(' '), fill: 'none',
            stroke: colour, 'stroke-width': 2, 'stroke-dasharray': i > 0 ? '6 3' : null }));
    });
    const legend = known.length > 1 || known[0]!.label
        ? h('span', { class: 'legend' }, ...known.map((each, i) => {
            const key = h('span', { class: 'key', 'aria-hidden': 'true' });
            key.style.background = seriesColour(i);
            return h('span', {}, key, each.label + (i > 0 ? ' (dashed)' : ''));
        })) : null;
    return h('figure', {}, h('figcaption', {}, h('span', { class: 'chart-title' }, `${title}, ${unit}`), legend), picture);
}

function wordsOf(title: string, unit: string, all: readonly Distribution[]): string {
    const told = all.map(({ label, bins }) => {
        const shares = cumulativeOf(bins);
        const at = (share: number): number => bins[shares.findIndex((each) => each >= share)]?.to ?? bins.at(-1)!.to;
        return `${label && `${label}: `}5 % at or below ${at(0.05)}, half at or below ${at(0.5)}, 95 % at or below ${at(0.95)} ${unit}`;
    });
    return `${title}: ${told.join('; ')}`;
}

export function distributionView(model: Model): HTMLElement {
    const choice = h('select', { 'aria-label': 'Cell' });
    const place = h('div', { class: 'small-charts' });
    const fill = (): void => {
        const cells = [...new Set(model.figures.cells.map((stay) => stay.cell))].sort(byNumber.compare);
        const chosen = choice.value;
        choice.replaceChildren(h('option', { value: '' }, `all cells (${counted(cells.length, 'cell')})`),
            ...cells.map((cell) => h('option', { value: cell }, cell)));
        choice.value = cells.includes(chosen) ? chosen : '';
    };
    const draw = async (): Promise<void> => {
        const { measures, cells } = model.figures;
        const charts = await Promise.all(measures.map(async (measure) => {
            const all = await allOf(model, measure);
            const pieces = choice.value === '' ? all
                : all.map((piece, i) => inCell(piece, cells.filter((stay) => model.source.isLive || stay.stretch === i), choice.value));
            return distributionChart(measureName(measure, measures), measure.unit, [distributionOf(pieces, '')]);
        }));
        place.replaceChildren(...charts);
    };
    fill();
    void draw();
    choice.addEventListener('change', () => void draw());
    let ticks = model.figures.head.ticks;
    model.on('data', () => {
        // One tick of many changes little, and costs all of them.
        if (Math.abs(model.figures.head.ticks - ticks) < ticks / 100) return;
        ticks = model.figures.head.ticks;
        fill();
        void draw();
    });
    return section('spread', 'Distributions', h('p', { class: 'quiet' }, 'Bars: time in each step of one unit, the highest at 100 %. Line: share of the time at or below a value.'),
        h('label', {}, 'While in ', choice), place);
}
