// A track on a plane, and where on it an instant is.

/** Seconds, latitude, longitude in degrees. */
export type TrackPoint = readonly [number, number, number];

export interface PlacedPoint {
    time: number;
    x: number;
    y: number;
}

const metresOfDegree = 111_320;

/** The points in metres east and south of the north-western corner, with the size of all. */
export function placedOf(points: readonly TrackPoint[]): { points: PlacedPoint[]; width: number; height: number } {
    const latitudes = points.map((point) => point[1]);
    const longitudes = points.map((point) => point[2]);
    const north = latitudes.reduce((a, b) => Math.max(a, b), -90);
    const south = latitudes.reduce((a, b) => Math.min(a, b), 90);
    const west = longitudes.reduce((a, b) => Math.min(a, b), 180);
    const shrink = Math.cos((((north + south) / 2) * Math.PI) / 180);
    const placed = points.map(([time, latitude, longitude]) => ({
        time, x: (longitude - west) * metresOfDegree * shrink, y: (north - latitude) * metresOfDegree }));
    return { points: placed, width: placed.reduce((most, point) => Math.max(most, point.x), 0),
        height: placed.reduce((most, point) => Math.max(most, point.y), 0) };
}

/** The place at a time, between the points around it; null before the first and after the last. */
export function placeAt(points: readonly PlacedPoint[], time: number): { x: number; y: number } | null {
    let end = points.findIndex((point) => point.time >= time);
    if (end < 0) return null;
    if (end === 0) {
        if (points[0]!.time > time) return null;
        end = 1;
    }
    const [one, other] = [points[end - 1]!, points[end] ?? points[end - 1]!];
    const share = other.time > one.time ? (time - one.time) / (other.time - one.time) : 0;
    return { x: one.x + share * (other.x - one.x), y: one.y + share * (other.y - one.y) };
}

/** A round length in metres of at most a third of the width: 1, 2 or 5 times a power of ten. */
export function scaleLength(width: number): number {
    const most = Math.max(width / 3, 1);
    const power = 10 ** Math.floor(Math.log10(most));
    return power * ([5, 2].find((factor) => factor * power <= most) ?? 1);
}
