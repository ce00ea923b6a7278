// The tolerance band about a contour.

import {Tracer} from './geometry.js';

const BAND_STEP = 0.5;  // pixels: bands that differ by less are drawn alike

/** The band as path data by its width on the canvas. */
export function bandPaths(scene, view) {
  const widthOf = (w) => Math.min(20000, 2 * scene.times * w * view.scale);
  const margin = 0.5 * widthOf(scene.largestTolerance) + 4;
  const paths = new Map();
  const pathOf = (width) => {
    if (!paths.has(width)) {
      const path = new Path2D();
      paths.set(width, {path, tracer: new Tracer(view, path, margin)});
    }
    return paths.get(width).tracer;
  };
  if (scene.isToleranceUniform) {
    const tracer = pathOf(widthOf(scene.largestTolerance));
    for (const piece of scene.pieces) tracer.trace(piece);
    return paths;
  }
  const {piece, from, to, tolerance} = scene.band;
  const least = 0.5 / view.scale;
  for (let i = 0; i < piece.length; ++i) {
    // Sections too short to be seen are drawn together, with the largest of their tolerances.
    const first = i;
    let largest = tolerance[i];
    while (to[i] - from[first] < least && piece[i + 1] === piece[first]) {
      ++i;
      largest = Math.max(largest, tolerance[i]);
    }
    const width = Math.max(1, Math.round(widthOf(largest) / BAND_STEP)) * BAND_STEP;
    pathOf(width).trace(scene.pieces[piece[first]], from[first], to[i]);
  }
  return paths;
}
