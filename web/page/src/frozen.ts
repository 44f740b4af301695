// The source of a report: its data are in the document, as report/PageData.h describes them.
import { type Changes, denseOf, thinned, valueAt } from './logic/changes.js';
import type { Drawn, Figures, Source, State } from './source.js';

interface Described {
    figures: Figures;
    series: number[];
    paths: string[][];
    texts: string[];
}

async function inflated(id: string): Promise<ArrayBuffer> {
    const element = document.getElementById(id);
    if (element === null) throw new Error(`the page has no ${id}`);
    const packed = Uint8Array.from(atob(element.textContent.trim()), (c) => c.charCodeAt(0));
    element.remove(); // the text is larger than what it holds
    const stream = new Blob([packed]).stream().pipeThrough(new DecompressionStream('deflate-raw'));
    return new Response(stream).arrayBuffer();
}

export async function embeddedJson(id: string): Promise<unknown> {
    return JSON.parse(new TextDecoder().decode(await inflated(id)));
}

/** The 32-bit words of a report, read one after the other. */
class Words {
    private readonly view: DataView;
    private at = 0;

    constructor(buffer: ArrayBuffer) {
        this.view = new DataView(buffer);
    }
    next(): number {
        this.at += 4;
        return this.view.getUint32(this.at - 4, true);
    }
    nextSigned(): number {
        this.at += 4;
        return this.view.getInt32(this.at - 4, true);
    }
    private nextFloat(): number {
        this.at += 4;
        return this.view.getFloat32(this.at - 4, true);
    }
    changes(areNumbers: boolean): Changes {
        const count = this.next();
        const ticks = new Uint32Array(count);
        const values = areNumbers ? new Float32Array(count) : new Uint32Array(count);
        let tick = 0;
        for (let i = 0; i < count; ++i) ticks[i] = tick += this.next();
        for (let i = 0; i < count; ++i) values[i] = areNumbers ? this.nextFloat() : this.next();
        return { ticks, values };
    }
}

export class FrozenSource implements Source {
    readonly isLive = false;
    /** Of each tick, in seconds. */
    readonly times: Float64Array;
    private readonly series_: Map<number, Changes>;
    private readonly dense = new Map<number, Float32Array>();
    private readonly columns: Changes[];

    private constructor(
        private readonly described: Described,
        words: Words,
    ) {
        this.times = new Float64Array(words.next());
        let milliseconds = Math.round(1000 * described.figures.head.from);
        for (let i = 0; i < this.times.length; ++i) {
            milliseconds += words.nextSigned();
            this.times[i] = milliseconds / 1000;
        }
        this.series_ = new Map(described.series.map((id) => [id, words.changes(true)]));
        this.columns = described.paths.map(() => words.changes(false));
    }

    static async read(place: number): Promise<FrozenSource> {
        const described = (await embeddedJson(`figures-${place}`)) as Described;
        return new FrozenSource(described, new Words(await inflated(`numbers-${place}`)));
    }

    figures(): Promise<Figures> {
        return Promise.resolve(this.described.figures);
    }

    /** The ticks of a stretch. */
    private range(stretch: number): [number, number] {
        const counts = this.described.figures.head.stretches.map((each) => each.ticks);
        const begin = counts.slice(0, stretch).reduce((sum, each) => sum + each, 0);
        return [begin, begin + (counts[stretch] ?? 0)];
    }

    series(ids: readonly number[], from: number, to: number, points: number, stretch: number): Promise<Drawn> {
        const [first, last] = this.range(stretch);
        const [begin, end] = [lowerBound(this.times, from, first, last), lowerBound(this.times, to, first, last, true)];
        const all = ids.map((id) => this.valuesOf(id));
        return Promise.resolve(thinned(this.times, all, begin, end, points));
    }

    private valuesOf(id: number): Float32Array {
        let values = this.dense.get(id);
        if (values === undefined) {
            const changes = this.series_.get(id);
            values = changes === undefined ? new Float32Array(this.times.length).fill(NaN)
                : denseOf(changes, this.times.length);
            this.dense.set(id, values);
        }
        return values;
    }

    stateAt(time: number, stretch: number): Promise<State> {
        const [first, last] = this.range(stretch);
        return Promise.resolve(this.stateOf(Math.max(first, lowerBound(this.times, time, first, last, true) - 1)));
    }

    private stateOf(tick: number): State {
        const rows = [];
        for (const [i, column] of this.columns.entries()) {
            const text = valueAt(column, tick);
            if (text) rows.push({ path: this.described.paths[i]!, text: this.described.texts[text]! });
        }
        return { time: this.times[tick] ?? 0, rows };
    }

    onTick(): () => void {
        return () => undefined;
    }
}

/** The first place from `begin` on whose time is at least, or with `isAfter` greater than, `time`. */
function lowerBound(times: Float64Array, time: number, begin: number, end: number, isAfter = false): number {
    while (begin < end) {
        const middle = (begin + end) >> 1;
        if (times[middle]! < time || (isAfter && times[middle] === time)) begin = middle + 1;
        else end = middle;
    }
    return begin;
}
