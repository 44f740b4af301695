// The data of a live page: figures as server-sent events, everything else on demand.
import { rowsOf } from './logic/rows.js';
import type { Drawn, Figures, Seconds, Source, State } from './source.js';

async function get(path: string): Promise<unknown> {
    const response = await fetch(path);
    if (!response.ok) throw new Error((await response.text()).trim());
    return response.json();
}

export class LiveSource implements Source {
    readonly isLive = true;
    /** Why nothing changes, in a few words; empty while all is well. */
    onWords: (text: string) => void = () => undefined;
    private latest: Partial<Figures> = {};
    private readonly listeners = new Set<(figures: Figures) => void>();
    private readonly first: Promise<Figures>;

    constructor() {
        const events = new EventSource('/api/events');
        this.first = new Promise((resolve) => {
            events.addEventListener('tick', (event: MessageEvent<string>) => {
                this.latest = { ...this.latest, ...(JSON.parse(event.data) as Partial<Figures>) };
                if ((this.latest.head?.ticks ?? 0) === 0) return; // nothing has come yet
                const figures = this.latest as Figures;
                resolve(figures);
                for (const listener of this.listeners) listener(figures);
            });
        });
        events.addEventListener('words', (event: MessageEvent<string>) => {
            this.onWords((JSON.parse(event.data) as { text: string }).text);
        });
        events.addEventListener('error', () => this.onWords('No connection to pallax web'));
    }

    figures(): Promise<Figures> {
        return this.first;
    }

    async series(ids: readonly number[], from: Seconds, to: Seconds, points: number): Promise<Drawn> {
        const most = Math.min(20000, Math.max(2, Math.round(points)));
        const path = `/api/series?ids=${ids.join(',')}&from=${from}&to=${to}&points=${most}`;
        return (await get(path)) as Drawn;
    }

    async stateAt(time: Seconds): Promise<State> {
        const { display, ...state } = (await get(`/api/state?at=${time}`)) as { time: Seconds; tick: number; display: unknown };
        return { ...state, rows: rowsOf(display) };
    }

    onTick(listener: (figures: Figures) => void): () => void {
        this.listeners.add(listener);
        return () => this.listeners.delete(listener);
    }
}
