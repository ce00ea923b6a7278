// Numbers for people, ticks of axes, colours of the style sheet.

/** At most `digits` significant digits, without trailing zeros. */
export function short(value, digits = 6) {
  return value === null || value === undefined ? '' : String(Number(value.toPrecision(digits)));
}

/** Always `decimals` digits after the point; zero never carries a minus sign. */
export function fixed(value, decimals) {
  if (!(Math.abs(value) < 1e9)) return short(value, 9);
  return value.toFixed(decimals).replace(/^-(0\.?0*)$/, '$1');
}

/** Digits after the point that tell a hundredth of a length. */
export function decimalsFor(length) {
  return Math.min(9, Math.max(0, 2 - Math.floor(Math.log10(length)))) || 0;
}

const FEWEST_OF_RELATIVE = 4;
// Tells the doubles next to 1 from it.
const MOST_OF_RELATIVE = 16;

/** Digits after the point so that none of the multiples of a tolerance reads as 1 but 1 itself. */
export function decimalsOfRelatives(values) {
  let decimals = FEWEST_OF_RELATIVE;
  const isMisread = (value) => value !== 1 && Number(value.toFixed(decimals)) === 1;
  while (decimals < MOST_OF_RELATIVE && values.some(isMisread)) ++decimals;
  return decimals;
}

/** A multiple of a tolerance: four digits, or as many more as tell it from 1. */
export function relativeText(value) {
  let digits = FEWEST_OF_RELATIVE;
  while (digits < 17 && value !== 1 && short(value, digits) === '1') ++digits;
  return short(value, digits);
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
