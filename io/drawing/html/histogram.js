// How many deviations lie in which range.

import {relativeText, short} from './numbers.js';
import {swatch} from './table.js';

const PANEL_WIDTH = 260;
const MARGINS = {left: 8, right: 8, top: 10, bottom: 36};

/** Heights of the bars from 0 to 1, those beyond the ends of the ranges first and last. */
export function barsOf(histogram) {
  const counts = [histogram.below, ...histogram.counts, histogram.above];
  const most = Math.max(1, ...counts);
  return counts.map((count) => count / most);
}

/** The picture as markup: numbers and names of our own, nothing of the user's. */
export function histogramMarkup(histogram, units, height) {
  const bars = barsOf(histogram);
  const room = height - MARGINS.top - MARGINS.bottom;
  const step = (PANEL_WIDTH - MARGINS.left - MARGINS.right) / bars.length;
  const base = MARGINS.top + room;
  const rects = bars.map((share, i) => {
    const isBeyond = i === 0 || i === bars.length - 1;
    const color = isBeyond && histogram.kind === 'relative' ? 'outside' : 'band-edge';
    // What is there at all can be seen.
    const size = share > 0 ? Math.max(1.5, share * room) : 0;
    const left = MARGINS.left + i * step + 0.5;
    return `<rect x="${left.toFixed(2)}" y="${(base - size).toFixed(2)}" ` +
        `width="${(step - 1).toFixed(2)}" height="${size.toFixed(2)}" fill="var(--${color})"/>`;
  });
  const isRelative = histogram.kind === 'relative';
  const text = (x, y, anchor, words) => `<text x="${x}" y="${y}" text-anchor="${anchor}" ` +
      `font-size="11" fill="var(--soft)">${words}</text>`;
  const end = isRelative ? relativeText(-histogram.low) : short(-histogram.low, 3);
  const left = MARGINS.left + step, right = PANEL_WIDTH - MARGINS.right - step;
  return rects.join('') +
      `<line x1="${MARGINS.left}" y1="${base}" x2="${PANEL_WIDTH - MARGINS.right}" y2="${base}" ` +
      'stroke="var(--border)"/>' +
      text(left, base + 14, 'middle', `-${end}`) +
      text(0.5 * PANEL_WIDTH, base + 14, 'middle', '0') + text(right, base + 14, 'middle', end) +
      text(0.5 * PANEL_WIDTH, base + 30, 'middle',
           isRelative ? 'multiple of the tolerance' : units);
}

/** Puts the histogram into its place. */
export function fillHistogram(place, scene) {
  const height = 198;
  const units = scene.units === 'mm' || scene.units === 'inch' ? `deviation in ${scene.units}`
                                                               : 'deviation';
  place.replaceChildren(
      swatch(histogramMarkup(scene.summary.histogram, units, height), PANEL_WIDTH, height));
}
