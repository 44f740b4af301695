// Values that hold until they change, and what is drawn of them.
import type { Drawn } from '../source.js';

/** `values[i]` holds from tick `ticks[i]` on. */
export interface Changes {
    ticks: Uint32Array;
    values: Float32Array | Uint32Array;
}

/** The value at a tick; 0 before the first change. */
export function valueAt(changes: Changes, tick: number): number {
    let begin = 0;
    let end = changes.ticks.length;
    while (begin < end) {
        const middle = (begin + end) >> 1;
        if (changes.ticks[middle]! <= tick) begin = middle + 1;
        else end = middle;
    }
    return begin > 0 ? changes.values[begin - 1]! : 0;
}

/** The value at each tick; NaN before the first change. */
export function denseOf(changes: Changes, ticks: number): Float32Array {
    const values = new Float32Array(ticks).fill(NaN);
    changes.ticks.forEach((from, i) => {
        values.fill(changes.values[i]!, from, changes.ticks[i + 1] ?? ticks);
    });
    return values;
}

/** Ticks that are farther apart, in seconds, have a hole between them. */
export const hole = 10;

/**
 * The ticks from `begin` to `end` (excluded). Of too many, groups of them become two points each,
 * the least and the greatest value in the order of the first series; no peak is lost. A hole in
 * the time becomes a point without values.
 */
export function thinned(
    times: Float64Array,
    series: readonly Float32Array[],
    begin: number,
    end: number,
    points: number,
): Drawn {
    const group = Math.max(1, Math.ceil((2 * (end - begin)) / Math.max(points, 2)));
    const drawn: Drawn = { times: [], values: series.map(() => []) };
    const add = (time: number, values: (which: number) => number): void => {
        drawn.times.push(time);
        for (let i = 0; i < series.length; ++i) {
            const value = values(i);
            drawn.values[i]!.push(Number.isNaN(value) ? null : value);
        }
    };
    for (let from = begin; from < end; ) {
        let to = from + 1;
        while (to < end && to < from + group && times[to]! - times[to - 1]! <= hole) ++to;
        if (to - from <= 2) {
            for (let i = from; i < to; ++i) add(times[i]!, (which) => series[which]![i]!);
        } else {
            const extremes = series.map((values) => extremesOf(values, from, to));
            add(times[from]!, (which) => extremes[which]!.first);
            add(times[to - 1]!, (which) => extremes[which]!.second);
        }
        if (to < end && times[to]! - times[to - 1]! > hole) add(times[to - 1]! + 0.001, () => NaN);
        from = to;
    }
    return drawn;
}

/** The least and the greatest value, the earlier one first. */
function extremesOf(values: Float32Array, from: number, to: number): { first: number; second: number } {
    let least = NaN;
    let most = NaN;
    let isLeastFirst = true;
    for (let i = from; i < to; ++i) {
        const value = values[i]!;
        if (Number.isNaN(value)) continue;
        if (!(value >= least)) {
            least = value;
            isLeastFirst = false;
        }
        if (!(value <= most)) {
            most = value;
            isLeastFirst = true;
        }
    }
    return isLeastFirst ? { first: least, second: most } : { first: most, second: least };
}

/** The latest value at a time, if it is not older than a hole; null otherwise. */
export function valueNear(drawn: Drawn, which: number, time: number): number | null {
    let begin = 0;
    let end = drawn.times.length;
    while (begin < end) {
        const middle = (begin + end) >> 1;
        if (drawn.times[middle]! <= time) begin = middle + 1;
        else end = middle;
    }
    return begin > 0 && time - drawn.times[begin - 1]! <= hole ? drawn.values[which]![begin - 1]! : null;
}
