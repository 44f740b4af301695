import { seriesColour, styleColour } from '../colours.js';
import { button, h, section } from '../dom.js';
import { chartedNeighbours } from '../logic/neighbours.js';
import { clockText, durationText, measureName, timeText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { EventRow, Figures, Lane } from '../source.js';
import { type ChartOf, Charts } from './charts.js';
import { laneView, type LaneSpan } from './lanes.js';

/** The levels of the serving cell, and those of the neighbours that come closest to them. */
function chartsOf(figures: Figures): ChartOf[] {
    const charts: ChartOf[] = figures.measures.map((measure) => ({
        title: measureName(measure, figures.measures),
        unit: measure.unit,
        range: [Math.min(measure.worst, measure.best), Math.max(measure.worst, measure.best)],
        borders: measure.borders,
        curves: [{ label: 'serving cell', colour: seriesColour(0), id: measure.id, isBold: true }],
    }));
    const groups = chartedNeighbours(figures.neighbours);
    for (const group of groups) {
        const { system, measure, unit } = group[0]!;
        const serving = figures.measures.find((each) => each.system === system && each.measure === measure && measure);
        const levels = group.flatMap((each) => [each.best ?? 0, each.median ?? 0]);
        charts.push({
            title: `Neighbours${groups.length > 1 ? `, ${system}` : ''}: ${serving?.name ?? 'level'}`,
            unit,
            range: serving ? [serving.worst, serving.best] : [Math.min(...levels) - 10, Math.max(...levels) + 5],
            borders: [],
            curves: [
                ...(serving ? [{ label: 'serving', colour: styleColour('ink'), id: serving.id, isBold: true }] : []),
                ...group.map((each, i) => ({ label: each.cell, colour: seriesColour(i), id: each.id })),
            ],
        });
    }
    return charts;
}

const important = new Set(['service-lost', 'fatal-record', 'ping-pong', 'gap', 'time-step', 'alarm']);

function eventSpans(events: readonly EventRow[]): LaneSpan[] {
    const spans = events.map((event) => ({ from: event.time, to: event.time,
        text: `${clockText(event.time)} ${event.kind}: ${event.words}`,
        colour: important.has(event.kind) ? seriesColour(1) : seriesColour(6) }));
    return spans.sort((a, b) => (a.colour < b.colour ? 1 : a.colour > b.colour ? -1 : a.from - b.from)); // those that matter on top
}

function spansOfLane(model: Model, lane: Lane | undefined, from: number): LaneSpan[] {
    const texts = [...new Set(lane?.spans.map((span) => span.text))];
    return model.inStretch(lane?.spans ?? []).map((span) => ({ ...span, colour: seriesColour(from + texts.indexOf(span.text)) }));
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
        model.inStretch(model.figures.cells).filter((stay) => stay.system === system).map((stay) => ({ from: stay.from, to: stay.to,
            text: stay.cell.replace(/^\S+ (?=\S+$)/, ''), colour: model.colours.of(stay.cell), isMarked: stay.pingPong }))));
    const states = figures.states.map(({ name }) => lane(`state ${name}`, model, name,
        () => spansOfLane(model, model.figures.states.find((each) => each.name === name), 0)));
    const contexts = figures.contexts.map(({ name }) => lane(`context ${name}`, model, name,
        () => spansOfLane(model, model.figures.contexts.find((each) => each.name === name), 2)));
    return [...cells, ...states, ...contexts, lane('events', model, 'Events', () => eventSpans(model.inStretch(model.figures.events)), true)];
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

/** Chooses the shown stretch where the clock was set back; nothing where it never was. */
function stretchChooser(model: Model): HTMLElement {
    const choice = h('select', { 'aria-label': 'Stretch of time' });
    const told = h('span');
    const place = h('p', { class: 'note' }, 'The clock was set back. Show ', choice, ' ', told);
    const draw = (): void => {
        const { stretches } = model.figures.head;
        place.hidden = stretches.length < 2;
        choice.replaceChildren(...stretches.map((each, i) => h('option', { value: i },
            `${i + 1} of ${stretches.length}: ${timeText(each.from)} to ${timeText(each.to)}`)));
        choice.value = String(model.stretch);
        const [before, shown] = [stretches[model.stretch - 1], stretches[model.stretch]];
        told.textContent = before && shown ? `It begins ${durationText(before.to - shown.from)} before the end of stretch ${model.stretch}.` : '';
    };
    choice.addEventListener('change', () => model.choose(Number(choice.value)));
    model.on('data', draw);
    model.on('stretch', draw);
    draw();
    return place;
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
        stretchChooser(model), tools, area),
        start: async () => {
            await charts.make();
            model.tell('cursor'); // the lanes have their width now
        },
    };
}
