// What the page shows, wherever it comes from. A report holds its data (frozen.ts); a server gives
// it on demand. All texts are plain: they come from modems and may hold anything.

/** Seconds since 1970 in UTC, in whole milliseconds. */
export type Seconds = number;

export interface Source {
    readonly isLive: boolean;
    /** What `pallax report --json` prints. */
    figures(): Promise<Figures>;
    /** At most about `points` points between two times of a stretch, on one ascending axis for all series. */
    series(ids: readonly number[], from: Seconds, to: Seconds, points: number, stretch: number): Promise<Drawn>;
    /** The state at the latest tick of a stretch at or before a time, or else at its first. */
    stateAt(time: Seconds, stretch: number): Promise<State>;
    /** Calls the listener at each display tick of a live modem. Returns what stops that. */
    onTick(listener: (figures: Figures) => void): () => void;
}

export interface Figures {
    head: Head;
    measures: Measure[];
    cells: Stay[];
    neighbours: Neighbour[];
    states: Lane[];
    contexts: Lane[];
    events: EventRow[];
}

export interface Head {
    title: string;
    /** Of the device, as its user calls it. */
    label: string;
    recording: string;
    technology: string;
    operator: string;
    from: Seconds;
    to: Seconds;
    packets: number;
    ticks: number;
    /** Between two ticks, in seconds. */
    interval: number;
    gaps: number;
    timeSteps: number;
    cellChanges: number;
    pingPongs: number;
    version: string;
    identities: 'left out' | 'included';
    where: string;
    notes: string[];
    profile: Profile;
    /** Several where the clock was set back. */
    stretches: { from: Seconds; to: Seconds; ticks: number }[];
}

export interface Profile {
    name: string;
    source: string;
    /** By measure ("rsrp"), the best first. */
    borders: Record<string, Border[]>;
    /** The places of the display that it judges; `*` in a path is any entry of a list. */
    graded: { path: string; measure: string }[];
}

export interface Border {
    grade: string;
    value: number;
}

/** A level of the serving cell. */
export interface Measure {
    id: number;
    name: string;
    system: string;
    unit: string;
    /** As in profiles; empty for a level that none can judge. */
    measure: string;
    meaning: string;
    /** The range of its axis. */
    worst: number;
    best: number;
    borders: Border[];
    /** How long it was known, in seconds. */
    seconds: number;
    /** Of that time, the best first; empty if the profile does not judge it. */
    shares: { grade: string; share: number }[];
    quantiles: { p5: number; p50: number; p95: number; least: number; most: number } | null;
    worstStretch: ({ from: Seconds; to: Seconds; mean: number } & Located) | null;
}

/** Where the clock was set back, a time alone does not tell when something was. */
export interface Located {
    /** Its place in `Head.stretches`. */
    stretch: number;
}

/** A stay in a cell. */
export interface Stay extends Located {
    system: string;
    cell: string;
    details: string[];
    from: Seconds;
    to: Seconds;
    pingPong: boolean;
}

export interface Neighbour {
    id: number;
    system: string;
    cell: string;
    unit: string;
    measure: string;
    seconds: number;
    best: number | null;
    median: number | null;
    /** Seconds within 5 dB of the serving cell, or above it. */
    near: number;
    stronger: number;
    /** Seconds in which the phone found it without a list. */
    detected: number;
    served: boolean;
    /** How often it became the serving cell without being in a list. */
    unlisted: number;
}

export interface Lane {
    name: string;
    spans: ({ from: Seconds; to: Seconds; text: string } & Located)[];
}

export interface EventRow extends Located {
    time: Seconds;
    packet: number;
    kind: string;
    words: string;
}

/** `values[i]` belongs to the i-th of the ids that were asked for; null or NaN is nothing. */
export interface Drawn {
    times: number[];
    values: (number | null)[][];
}

export interface State {
    time: Seconds;
    rows: StateRow[];
}

export interface StateRow {
    /** Keys; an entry of a list has its position. */
    path: string[];
    text: string;
}
