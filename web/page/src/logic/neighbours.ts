// Which neighbours have a curve.
import type { Neighbour } from '../source.js';

const most = 6;

/** Groups of one system and measure, each with the neighbours that come closest to the serving cell. */
export function chartedNeighbours(neighbours: readonly Neighbour[]): Neighbour[][] {
    const groups = new Map<string, Neighbour[]>();
    for (const each of neighbours.filter((one) => one.seconds > 0)) {
        const kind = JSON.stringify([each.system, each.measure, each.unit]);
        const group = groups.get(kind) ?? [];
        if (group.length < most) group.push(each);
        groups.set(kind, group);
    }
    return [...groups.values()];
}
