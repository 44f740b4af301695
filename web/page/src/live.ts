// The data of a live page: figures as server-sent events, everything else on demand.
import { patched, type Patch } from './logic/patch.js';
import { rowsOf } from './logic/rows.js';
import type { Drawn, Figures, Seconds, Source, State } from './source.js';

const mostPoints = 50_000; // that the server gives
const farthest = 9e9; // a time in seconds

/** Without one, the server takes the latest stretch of time. */
function inStretch(stretch: number | undefined): string {
    return stretch === undefined ? '' : `&stretch=${stretch}`;
}

export class LiveSource implements Source {
    readonly isLive = true;
    /** Why nothing changes, in a few words; empty while all is well. */
    onWords: (text: string) => void = () => undefined;
    private latest: unknown = {};
    private readonly listeners = new Set<(figures: Figures) => void>();
    private readonly first: Promise<Figures>;
    /** Several views ask for the same at a tick. */
    private readonly asked = new Map<string, Promise<unknown>>();

    constructor() {
        const events = new EventSource('/api/events');
        this.first = new Promise((resolve) => {
            const take = (figures: unknown): void => {
                this.latest = figures;
                if (((figures as Partial<Figures>).head?.ticks ?? 0) === 0) return; // nothing has come yet
                resolve(figures as Figures);
                for (const listener of this.listeners) listener(figures as Figures);
            };
            events.addEventListener('figures', (event: MessageEvent<string>) => take(JSON.parse(event.data)));
            events.addEventListener('patch', (event: MessageEvent<string>) =>
                take(patched(this.latest, JSON.parse(event.data) as Patch)));
        });
        events.addEventListener('words', (event: MessageEvent<string>) => {
            this.onWords((JSON.parse(event.data) as { text: string }).text);
        });
        events.addEventListener('error', () => this.onWords(events.readyState === EventSource.CLOSED
            ? 'The server has ended: open the link that pallax web prints when it starts again'
            : 'No connection to pallax web'));
    }

    figures(): Promise<Figures> {
        return this.first;
    }

    async series(ids: readonly number[], from: Seconds, to: Seconds, points: number, stretch?: number): Promise<Drawn> {
        const [begin, end] = [Math.max(from, -farthest), Math.min(to, farthest)];
        const most = Math.min(mostPoints, Math.max(2, Math.round(points)));
        return (await this.get(`/api/series?ids=${ids.join(',')}&from=${begin}&to=${end}&points=${most}${inStretch(stretch)}`)) as Drawn;
    }

    async stateAt(time: Seconds, stretch?: number): Promise<State> {
        const { display, ...state } = (await this.get(`/api/state?at=${time}${inStretch(stretch)}`)) as { time: Seconds; tick: number; display: unknown };
        return { ...state, rows: rowsOf(display) };
    }

    onTick(listener: (figures: Figures) => void): () => void {
        this.listeners.add(listener);
        return () => this.listeners.delete(listener);
    }

    private get(path: string): Promise<unknown> {
        const running = this.asked.get(path);
        if (running) return running;
        const answer = (async () => {
            const response = await fetch(path);
            if (!response.ok) throw new Error((await response.text()).trim());
            return response.json() as Promise<unknown>;
        })().finally(() => this.asked.delete(path));
        this.asked.set(path, answer);
        return answer;
    }
}
