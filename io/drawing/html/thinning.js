// Fewer marks, the same picture: of many points those that reach farthest to each side.

/**
 * The lowest and the highest of the points that share a key, such as a column of pixels.
 * @param count of points, which are numbered from 0
 * @param keyOf whole number for a point, or null to leave it out
 * @param valueOf number for a point
 * @return indexes {lowest, highest}, side by side, in the order in which the keys appear
 */
export function rangesBy(count, keyOf, valueOf) {
  const slots = new Map();
  const lowest = [], highest = [];
  let lastKey = null, slot = -1;
  for (let i = 0; i < count; ++i) {
    const key = keyOf(i);
    if (key === null) continue;
    if (key !== lastKey) {
      lastKey = key;
      slot = slots.get(key) ?? -1;
      if (slot < 0) {
        slot = lowest.length;
        slots.set(key, slot);
        lowest.push(i);
        highest.push(i);
        continue;
      }
    }
    const value = valueOf(i);
    if (value < valueOf(lowest[slot])) lowest[slot] = i;
    if (value > valueOf(highest[slot])) highest[slot] = i;
  }
  return {lowest, highest};
}

/** Keeps what was made last, for as long as it is asked for by the same key. */
export class Remembered {
  get(key, make) {
    if (this.key !== key) {
      this.value = make();
      this.key = key;
    }
    return this.value;
  }
}
