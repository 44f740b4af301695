// Curves over one time axis: the cursor and the zoom of one chart are those of all.
import uPlot from 'uplot';
import 'uplot/dist/uPlot.min.css';
import { styleColour } from '../colours.js';
import { h } from '../dom.js';
import { hole } from '../logic/changes.js';
import { bandWords, clockText, dateText, levelText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { Border } from '../source.js';

/** Beside the plots, so that lanes can stand below them. */
export const gutter = { left: 72, right: 32 };
const plotHeight = 150;

export interface CurveOf {
    label: string;
    colour: string;
    id: number;
    isBold?: boolean;
}

export interface ChartOf {
    title: string;
    unit: string;
    range: [number, number];
    borders: readonly Border[];
    curves: CurveOf[];
}

function axisTimes(splits: number[], step: number): string[] {
    return splits.map((time) => (step >= 86400 ? dateText(time) : clockText(time).slice(0, step >= 60 ? 5 : 8)));
}

/** The grades as shades behind the curve. */
function drawBands(chart: uPlot, of: ChartOf): void {
    if (of.borders.length === 0) return;
    const { left, width } = chart.bbox;
    const [low, high] = [chart.scales['y']!.min!, chart.scales['y']!.max!];
    const isSmallerBetter = of.borders.length > 1 && of.borders[0]!.value < of.borders[1]!.value;
    const edges = of.borders.map((border) => Math.min(Math.max(border.value, low), high));
    let best = isSmallerBetter ? low : high;
    for (const [i, border] of [...of.borders, { grade: 'none', value: NaN }].entries()) {
        const worst = edges[i] ?? (isSmallerBetter ? high : low);
        const [top, bottom] = [best, worst].map((value) => chart.valToPos(value, 'y', true)) as [number, number];
        chart.ctx.fillStyle = styleColour(`band-${border.grade}`);
        chart.ctx.fillRect(left, Math.min(top, bottom), width, Math.abs(bottom - top));
        best = worst;
    }
}

function optionsOf(of: ChartOf, width: number, model: Model): uPlot.Options {
    const axis = { stroke: () => styleColour('ink'), grid: { stroke: () => styleColour('line'), width: 1 },
        ticks: { stroke: () => styleColour('line'), width: 1 }, font: '12px system-ui, sans-serif' };
    return {
        width,
        height: plotHeight,
        padding: [8, gutter.right, 0, 0],
        tzDate: (time) => uPlot.tzDate(new Date(time * 1000), 'Etc/UTC'),
        cursor: { sync: { key: 'time', setSeries: false }, drag: { x: true, y: false }, points: { size: 6 } },
        legend: { show: false },
        scales: { x: { time: true, range: () => [model.from, model.to] }, y: { range: of.range } },
        axes: [
            { ...axis, size: 28, space: 70, values: (_chart, splits, _axis, _space, step) => axisTimes(splits, step) },
            { ...axis, size: gutter.left, space: 24 },
        ],
        series: [{}, ...of.curves.map((curve) => ({ label: curve.label, stroke: curve.colour,
            width: curve.isBold ? 2 : 1.25, points: { show: false }, spanGaps: false }))],
        hooks: {
            drawClear: [(chart) => drawBands(chart, of)],
            setSelect: [(chart) => {
                const { left, width: size } = chart.select;
                if (size > 0) model.show(chart.posToVal(left, 'x'), chart.posToVal(left + size, 'x'));
                chart.setSelect({ left: 0, top: 0, width: 0, height: 0 }, false);
            }],
        },
    };
}

/** Several charts that are zoomed and looked at together. */
export class Charts {
    readonly element = h('div', { class: 'charts' });
    private charts: { plot: uPlot; of: ChartOf; readings: HTMLElement[] }[] = [];
    private shown = '';
    private loading = 0;

    constructor(private readonly model: Model, private readonly chartsOf: () => ChartOf[]) {
        model.on('data', () => void (JSON.stringify(this.chartsOf()) === this.shown ? this.load() : this.make()));
        model.on('window', () => void this.load());
        model.on('cursor', () => this.setCursor());
        model.on('look', () => void this.make());
        new ResizeObserver(() => this.resize()).observe(this.element);
    }

    /** Resolves when everything is drawn. */
    make(): Promise<void> {
        for (const chart of this.charts) chart.plot.destroy();
        const width = Math.max(this.element.clientWidth, 240);
        this.element.replaceChildren();
        const charts = this.chartsOf();
        this.shown = JSON.stringify(charts);
        this.charts = charts.map((of) => {
            const readings = of.curves.map(() => h('span', { class: 'reading' }));
            const legend = h('span', { class: 'legend' }, ...of.curves.map((curve, i) => {
                const key = h('span', { class: 'key', 'aria-hidden': 'true' });
                key.style.background = curve.colour;
                return h('span', {}, key, curve.label, ' ', readings[i]!);
            }));
            const place = h('div', { class: 'plot', 'aria-hidden': 'true' });
            this.element.append(h('figure', {}, h('figcaption', {}, h('span', { class: 'chart-title' },
                `${of.title}${of.unit && `, ${of.unit}`}`), legend, h('span', { class: 'quiet' }, bandWords(of.borders))), place));
            const plot = new uPlot(optionsOf(of, width, this.model), [[]], place);
            // Not the plot's own hook: that also tells where its cursor comes to stand after a zoom.
            plot.over.addEventListener('mousemove', (event) => this.model.look(plot.posToVal(event.offsetX, 'x')));
            return { plot, of, readings };
        });
        return this.load();
    }

    private resize(): void {
        const width = Math.max(this.element.clientWidth, 240);
        for (const { plot } of this.charts) if (plot.width !== width) plot.setSize({ width, height: plotHeight });
    }

    private async load(): Promise<void> {
        const turn = ++this.loading;
        const ids = this.charts.flatMap((chart) => chart.of.curves.map((curve) => curve.id));
        const drawn = await this.model.source.series(ids, this.model.from, this.model.to,
            2 * Math.max(this.element.clientWidth, 240), this.model.stretch);
        if (turn !== this.loading) return; // a later part was asked for
        let next = 0;
        for (const { plot, of } of this.charts) {
            const values = of.curves.map(() => drawn.values[next++]!);
            plot.setData([drawn.times, ...values]);
        }
        this.setCursor();
    }

    private setCursor(): void {
        for (const { plot } of this.charts) {
            const left = plot.valToPos(this.model.cursor, 'x');
            if (Math.abs((plot.cursor.left ?? -10) - left) > 0.5) plot.setCursor({ left, top: -10 }, false);
        }
        void this.read();
    }

    /** The values at the cursor: what is drawn may stand for several ticks. */
    private async read(): Promise<void> {
        const { cursor, stretch } = this.model;
        const ids = this.charts.flatMap((chart) => chart.of.curves.map((curve) => curve.id));
        const { values } = await this.model.source.series(ids, cursor - hole, cursor, 4 * hole, stretch);
        if (cursor !== this.model.cursor || values.length !== this.charts.flatMap((chart) => chart.readings).length) return;
        let next = 0;
        for (const { of, readings } of this.charts) {
            for (const reading of readings) {
                const value = values[next++]!.at(-1);
                reading.textContent = typeof value === 'number' ? levelText(value, of.unit) : '–';
            }
        }
    }
}
