import { seriesColour, styleColour } from '../colours.js';
import { button, h, section } from '../dom.js';
import { clockText, measureName } from '../logic/text.js';
import type { Model } from '../model.js';
import type { Figures, Lane } from '../source.js';
import { type ChartOf, Charts } from './charts.js';
import { laneView, type LaneSpan } from './lanes.js';

const mostNeighbours = 6;

/** The levels of the serving cell, and those of the neighbours that come closest to them. */
function chartsOf(figures: Figures): ChartOf[] {
    const charts: ChartOf[] = figures.measures.map((measure) => ({
        title: measureName(measure, figures.measures),
        unit: measure.unit,
        range: [Math.min(measure.worst, measure.best), Math.max(measure.worst, measure.best)],
        borders: measure.borders,
        curves: [{ label: 'serving cell', colour: seriesColour(0), id: measure.id, isBold: true }],
    }));
    const kinds = new Set(figures.neighbours.filter((each) => each.seconds > 0)
        .map((each) => `${each.system}\n${each.measure}\n${each.unit}`));
    for (const kind of kinds) {
        const [system, measure, unit] = kind.split('\n') as [string, string, string];
        const own = figures.neighbours.filter((each) => each.seconds > 0 && each.system === system &&
            each.measure === measure && each.unit === unit);
        const serving = figures.measures.find((each) => each.system === system && each.measure === measure && measure);
        const levels = own.flatMap((each) => [each.best ?? 0, each.median ?? 0]);
        charts.push({
            title: `Neighbours${kinds.size > 1 ? `, ${system}` : ''}: ${serving?.name ?? 'level'}`,
            unit,
            range: serving ? [serving.worst, serving.best] : [Math.min(...levels) - 10, Math.max(...levels) + 5],
            borders: [],
            curves: [
                ...(serving ? [{ label: 'serving', colour: styleColour('ink'), id: serving.id, isBold: true }] : []),
                ...own.slice(0, mostNeighbours).map((each, i) => ({ label: each.cell, colour: seriesColour(i), id: each.id })),
            ],
        });
    }
    return charts;
}

const important = new Set(['service-lost', 'fatal-record', 'ping-pong', 'gap', 'time-step', 'alarm']);

function eventSpans(figures: Figures): LaneSpan[] {
    const spans = figures.events.map((event) => ({ from: event.time, to: event.time,
        text: `${clockText(event.time)} ${event.kind}: ${event.words}`,
        colour: important.has(event.kind) ? seriesColour(1) : seriesColour(6) }));
    return spans.sort((a, b) => (a.colour < b.colour ? 1 : a.colour > b.colour ? -1 : a.from - b.from)); // those that matter on top
}

function spansOfLane(lane: Lane | undefined, from: number): LaneSpan[] {
    const texts = [...new Set(lane?.spans.map((span) => span.text))];
    return (lane?.spans ?? []).map((span) => ({ ...span, colour: seriesColour(from + texts.indexOf(span.text)) }));
}

/** The lanes of the figures; those that were there before are the same elements. */
function lanesOf(model: Model, before: Map<string, HTMLElement>): HTMLElement[] {
    const { figures } = model;
    const lane = (key: string, ...make: Parameters<typeof laneView>): HTMLElement => {
        const made = before.get(key) ?? laneView(...make);
        before.set(key, made);
        return made;
    };
    const systems = [...new Set(figures.cells.map((stay) => stay.system))];
    const cells = systems.map((system) => lane(`cells ${system} ${systems.length}`, model, systems.length > 1 ? `${system} cells` : 'Cells', () =>
        model.figures.cells.filter((stay) => stay.system === system).map((stay) => ({ from: stay.from, to: stay.to,
            text: stay.cell.replace(/^\S+ (?=\S+$)/, ''), colour: model.colours.of(stay.cell), isMarked: stay.pingPong }))));
    const states = figures.states.map(({ name }) => lane(`state ${name}`, model, name,
        () => spansOfLane(model.figures.states.find((each) => each.name === name), 0)));
    const contexts = figures.contexts.map(({ name }, i) => lane(`context ${name}`, model, contextName(name, i),
        () => spansOfLane(model.figures.contexts.find((each) => each.name === name), 2)));
    return [...cells, ...states, ...contexts, lane('events', model, 'Events', () => eventSpans(model.figures), true)];
}

/** The name of a context is masked with the rest of it. */
export function contextName(name: string, place: number): string {
    return /^0*$/.test(name) ? `context ${place + 1}` : name;
}

function keysOf(model: Model): Record<string, () => void> {
    const step = model.figures.head.interval;
    return {
        ArrowLeft: () => model.goTo(model.cursor - step),
        ArrowRight: () => model.goTo(model.cursor + step),
        PageUp: () => model.goTo(model.cursor - 30 * step),
        PageDown: () => model.goTo(model.cursor + 30 * step),
        Home: () => model.goTo(model.whole()[0]),
        End: () => model.goTo(model.whole()[1]),
        '+': () => model.zoom(0.5),
        '-': () => model.zoom(2),
        '0': () => model.showAll(),
    };
}

/** The curves and lanes; `start` draws them once they are in the document. */
export function timelineView(model: Model): { element: HTMLElement; start: () => Promise<void> } {
    const charts = new Charts(model, () => chartsOf(model.figures));
    const known = new Map<string, HTMLElement>();
    const lanes = h('div', { class: 'lanes' }, ...lanesOf(model, known));
    model.on('data', () => {
        const wanted = lanesOf(model, known);
        if (wanted.length !== lanes.childElementCount) lanes.replaceChildren(...wanted);
    });
    const span = h('output', { class: 'quiet' });
    const showSpan = (): void => {
        span.textContent = `${clockText(model.from)} to ${clockText(model.to)} UTC`;
    };
    model.on('window', showSpan);
    showSpan();
    const keys = keysOf(model);
    const area = h('div', { class: 'area', tabindex: 0, role: 'application',
        'aria-label': 'Curves. Left and right arrow look at another tick, plus and minus zoom, 0 shows all.' }, lanes, charts.element);
    area.addEventListener('keydown', (event) => {
        const act = event.ctrlKey || event.metaKey || event.altKey ? undefined : keys[event.key];
        if (act) {
            event.preventDefault();
            act();
        }
    });
    area.addEventListener('dblclick', () => model.showAll());
    const tools = h('div', { class: 'tools' }, button('−', 'Zoom out', () => model.zoom(2)), button('+', 'Zoom in', () => model.zoom(0.5)),
        button('←', 'Earlier', () => model.move(-0.5)), button('→', 'Later', () => model.move(0.5)),
        button('All', 'Show the whole time', () => model.showAll()), span);
    return {
        element: section('time', 'Over time', h('p', { class: 'quiet' },
            'Drag to zoom, double-click to show all. With the keyboard: ← → one tick, Page Up and Page Down a minute, + − zoom, 0 all.'),
        tools, area),
        start: async () => {
            await charts.make();
            model.tell('cursor'); // the lanes have their width now
        },
    };
}
