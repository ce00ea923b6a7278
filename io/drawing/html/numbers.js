// Numbers for people, ticks of axes, colours of the style sheet.

/** At most `digits` significant digits, without trailing zeros. */
export function short(value, digits = 6) {
  return value === null || value === undefined ? '' : String(Number(value.toPrecision(digits)));
}

/** 1, 2 or 5 times a power of ten, not below `least`. */
export function niceStep(least) {
  const power = 10 ** Math.floor(Math.log10(least));
  for (const factor of [1, 2, 5]) {
    if (factor * power >= least * (1 - 1e-12)) return factor * power;
  }
  return 10 * power;
}

/** Round numbers in [low, high] no closer than `leastStep`, with their labels. */
export function ticksBetween(low, high, leastStep) {
  const step = niceStep(leastStep);
  const decimals = Math.min(12, Math.max(0, -Math.floor(Math.log10(step) + 1e-9)));
  const ticks = [];
  for (let i = Math.ceil(low / step); i * step <= high && ticks.length < 60; ++i) {
    const value = i * step;
    const isPlain = Math.abs(value) < 1e7 && step > 1e-7;
    const label = isPlain ? value.toFixed(decimals).replace(/^-(0\.?0*)$/, '$1') : short(value, 9);
    ticks.push({value, label});
  }
  return ticks;
}

/** The colours that the style sheet gives at this moment. */
export function readColors() {
  const style = getComputedStyle(document.documentElement);
  const colors = {};
  for (const name of ['paper', 'text', 'soft', 'border', 'grid', 'line', 'arc', 'line-tint',
                      'arc-tint', 'point', 'whisker', 'band', 'band-edge', 'start', 'worst',
                      'outside', 'chosen']) {
    colors[name] = style.getPropertyValue('--' + name).trim();
  }
  return colors;
}

/** The colours on paper, whatever the screen has. */
export function isPrinting() { return matchMedia('print').matches; }
