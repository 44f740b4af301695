// What all views share: the data, the shown part of the time, and the instant that is looked at.
import { CellColours } from './colours.js';
import type { Figures, Located, Seconds, Source } from './source.js';

export type Part = 'data' | 'stretch' | 'window' | 'cursor' | 'look' | 'hold';
type Listener = () => void;

const leastWindow = 4;

export class Model {
    /** The shown one of the stretches of time. */
    stretch: number;
    from: Seconds;
    to: Seconds;
    cursor: Seconds;
    colours: CellColours;
    /** Of a live modem: a page that looks back stays as it is until it follows again. */
    isFollowing = true;
    private held: Figures | null = null;
    private readonly listeners: [Part, Listener][] = [];

    constructor(
        readonly source: Source,
        public figures: Figures,
    ) {
        this.stretch = source.isLive ? this.latest() : this.longest();
        [this.from, this.to] = this.whole();
        this.cursor = this.to;
        this.colours = new CellColours(figures.cells.map((stay) => stay.cell));
    }

    on(part: Part, listener: Listener): void {
        this.listeners.push([part, listener]);
    }

    tell(part: Part): void {
        for (const [wanted, listener] of this.listeners) if (wanted === part) listener();
    }

    private longest(): number {
        const ticks = this.figures.head.stretches.map((stretch) => stretch.ticks);
        return Math.max(ticks.indexOf(ticks.reduce((a, b) => Math.max(a, b), 0)), 0);
    }

    private latest(): number {
        return Math.max(this.figures.head.stretches.length - 1, 0);
    }

    /** The time of the shown stretch; its first tick shows what happened in the interval before it. */
    whole(): [Seconds, Seconds] {
        const { stretches, from, to, interval } = this.figures.head;
        const shown = stretches[this.stretch] ?? { from, to };
        return [shown.from - interval, Math.max(shown.to, shown.from - interval + leastWindow)];
    }

    /** What is in the shown stretch. */
    inStretch<T extends Located>(all: readonly T[]): T[] {
        return all.filter((each) => each.stretch === this.stretch);
    }

    /** Shows the whole of another stretch. */
    choose(stretch: number): void {
        this.stretch = stretch;
        this.tell('stretch');
        this.showAll();
        this.look(this.to);
    }

    update(figures: Figures): void {
        if (!this.isFollowing) {
            this.held = figures;
            this.tell('hold');
            return;
        }
        const [from, to] = this.whole();
        const [atFrom, atEnd] = [this.from <= from, this.to >= to];
        this.figures = figures;
        this.colours = new CellColours(figures.cells.map((stay) => stay.cell));
        const isNew = this.stretch !== this.latest();
        if (isNew) this.showLatest();
        const [newFrom, end] = this.whole();
        if (atEnd && !isNew) {
            this.from = atFrom ? newFrom : this.from + (end - to);
            this.to = end;
        }
        this.tell('data');
        if (atEnd || isNew) this.tell('window');
        this.look(end);
    }

    private showLatest(): void {
        this.stretch = this.latest();
        [this.from, this.to] = this.whole();
    }

    /** The ticks that have come since the page is held. */
    newTicks(): number {
        return this.held === null ? 0 : Math.max(this.held.head.ticks - this.figures.head.ticks, 0);
    }

    hold(): void {
        this.setFollowing(false);
    }

    follow(): void {
        this.setFollowing(true);
        const { held } = this;
        this.held = null;
        if (this.stretch !== this.latest()) this.showLatest();
        if (held === null) this.look(this.whole()[1]);
        else this.update(held);
        this.tell('stretch');
        this.tell('window');
    }

    private setFollowing(isFollowing: boolean): void {
        if (isFollowing === this.isFollowing || !this.source.isLive) return;
        this.isFollowing = isFollowing;
        this.tell('hold');
    }

    /** Shows a part of the time. */
    show(from: Seconds, to: Seconds): void {
        const [first, last] = this.whole();
        const size = Math.min(Math.max(to - from, leastWindow), last - first);
        this.from = Math.min(Math.max(from, first), last - size);
        this.to = this.from + size;
        this.tell('window');
    }

    showAll(): void {
        this.show(...this.whole());
    }

    /** Shows half, or twice, the time around the cursor. */
    zoom(factor: number): void {
        const middle = Math.min(Math.max(this.cursor, this.from), this.to);
        this.show(middle - (middle - this.from) * factor, middle + (this.to - middle) * factor);
    }

    move(share: number): void {
        const by = share * (this.to - this.from);
        this.show(this.from + by, this.to + by);
    }

    /** Looks at an instant. */
    look(time: Seconds): void {
        const [first, last] = this.whole();
        this.cursor = Math.min(Math.max(time, first), last);
        if (this.cursor < last || this.stretch !== this.latest()) this.hold();
        else if (!this.isFollowing) this.follow();
        this.tell('cursor');
    }

    /** Goes to an instant that may not be shown. */
    goTo(time: Seconds, until = time, stretch = this.stretch): void {
        if (stretch !== this.stretch) this.choose(stretch);
        if (time < this.from || until > this.to) {
            const half = Math.max((this.to - this.from) / 2, until - time);
            this.show((time + until) / 2 - half, (time + until) / 2 + half);
        }
        this.look(time);
    }
}
