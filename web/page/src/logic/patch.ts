// What changes in the data of a live page (web/JsonPatch.h describes the form).
export type Patch =
    | { value: unknown }
    | { members: Record<string, Patch> }
    | { items: { drop: number; size: number; at: Record<string, Patch>; add: unknown[] } };

/** The value that a patch makes of another one, which stays as it is; what does not change is shared. */
export function patched(value: unknown, patch: Patch): unknown {
    if ('value' in patch) return patch.value;
    if ('members' in patch) {
        const object = { ...(value as Record<string, unknown>) };
        for (const [key, member] of Object.entries(patch.members)) object[key] = patched(object[key], member);
        return object;
    }
    const { drop, size, at, add } = patch.items;
    const list = (value as unknown[]).slice(drop, drop + size);
    for (const [index, item] of Object.entries(at)) list[Number(index)] = patched(list[Number(index)], item);
    return [...list, ...add];
}
