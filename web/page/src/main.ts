// The page of a report, and of a live modem.
import './style.css';
import { h } from './dom.js';
import { embeddedJson, FrozenSource } from './frozen.js';
import { LiveSource } from './live.js';
import type { TrackPoint } from './logic/track.js';
import { Model } from './model.js';
import type { Source } from './source.js';
import { cellsView, neighboursView } from './views/cells.js';
import { compareView } from './views/compare.js';
import { contextsView } from './views/contexts.js';
import { distributionView } from './views/distribution.js';
import { eventsView } from './views/events.js';
import { headView } from './views/head.js';
import { LiveBar } from './views/live.js';
import { stateView } from './views/state.js';
import { timelineView } from './views/timeline.js';
import { trackView } from './views/track.js';
import { verdictView } from './views/verdict.js';

const has = (id: string): boolean => document.getElementById(id) !== null;

function liveSource(bar: LiveBar): LiveSource {
    document.getElementById('page')!.before(bar.element);
    const source = new LiveSource();
    source.onWords = (text) => bar.say(text);
    return source;
}

async function sources(bar: LiveBar): Promise<Source[]> {
    const places = [0, 1].filter((place) => has(`figures-${place}`));
    if (places.length === 0) return [liveSource(bar)];
    return Promise.all(places.map((place) => FrozenSource.read(place)));
}

/** Canvases take their colours when they are drawn. */
function followLook(model: Model): void {
    const draw = (): void => model.tell('look');
    matchMedia('(prefers-color-scheme: dark)').addEventListener('change', draw);
    matchMedia('print').addEventListener('change', draw);
}

async function recordingPage(model: Model, track: TrackPoint[] | null, more: HTMLElement[]): Promise<HTMLElement> {
    const timeline = timelineView(model);
    const page = h('div', { class: 'recording' }, headView(model), ...more, verdictView(model),
        h('div', { class: 'beside' }, timeline.element, stateView(model)),
        ...(track ? [trackView(model, track)] : []), distributionView(model), cellsView(model), neighboursView(model), contextsView(model), eventsView(model));
    followLook(model);
    document.getElementById('page')!.replaceChildren(page);
    await timeline.start();
    return page;
}

/** Which of two recordings the views show. */
function chooser(models: readonly Model[], choose: (model: Model) => void): HTMLElement {
    const box = h('fieldset', { class: 'chooser' }, h('legend', {}, 'Show'));
    models.forEach((model, i) => {
        const input = h('input', { type: 'radio', name: 'recording', checked: i === 0 });
        input.addEventListener('change', () => choose(model));
        box.append(h('label', {}, input, ` ${['before', 'after'][i]!}: ${model.figures.head.recording}`));
    });
    return box;
}

async function main(): Promise<void> {
    const track = has('track') ? ((await embeddedJson('track')) as TrackPoint[]) : null;
    const bar = new LiveBar();
    const models = await Promise.all((await sources(bar)).map(async (source) => new Model(source, await source.figures())));
    const first = models[0];
    if (first === undefined) throw new Error('the page has no data');
    performance.mark('decoded');
    for (const model of models) model.source.onTick((figures) => model.update(figures));
    if (models[1] === undefined) {
        await recordingPage(first, track, []);
        if (first.source.isLive) bar.attach(first);
    } else {
        const comparison = compareView(first, models[1]);
        const pages = new Map<Model, HTMLElement>();
        const box = chooser(models, (model) => void show(model));
        const show = async (model: Model): Promise<void> => {
            const page = pages.get(model);
            if (page === undefined) pages.set(model, await recordingPage(model, track, [box, comparison]));
            else {
                document.getElementById('page')!.replaceChildren(page);
                page.querySelector('header')!.after(box, comparison);
                model.tell('look');
            }
        };
        await show(first);
    }
    Object.assign(globalThis, { pallaxModels: models }); // for tests
    requestAnimationFrame(() => requestAnimationFrame(() => {
        performance.mark('drawn');
        document.documentElement.dataset['ready'] = '1';
    }));
}

main().catch((error: unknown) => {
    document.getElementById('page')!.append(h('p', { class: 'note', role: 'alert' },
        `This page cannot be shown: ${error instanceof Error ? error.message : String(error)}.`));
    throw error;
});
