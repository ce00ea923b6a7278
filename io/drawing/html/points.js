// The measured points in the drawing of the contour.

import {cross} from './marks.js';
import {FEW_POINTS, Occupancy} from './scene.js';
import {rangesBy} from './thinning.js';

/** The points on the canvas that are not hidden behind others. */
export function visiblePoints({scene, view}) {
  const free = new Occupancy(view.width, view.height, scene.count > FEW_POINTS ? 1 : 0.25);
  const visible = [];
  for (let i = 0; i < scene.count; ++i) {
    if (free.take(view.px(scene.x[i]), view.py(scene.y[i]))) visible.push(i);
  }
  return visible;
}

/**
 * Of the points on the canvas, those that reach farthest to each side in each pixel along the
 * contour; nothing while few are on it or nothing is measured.
 */
export function pointRanges({scene, view}) {
  const none = {lowest: [], highest: []};
  if (!scene.isMeasured || scene.count <= FEW_POINTS) return none;
  const isOnCanvas = (i) => {
    const x = view.px(scene.x[i]), y = view.py(scene.y[i]);
    return x >= 0 && y >= 0 && x <= view.width && y <= view.height;
  };
  let onCanvas = 0;
  for (let i = 0; i < scene.count; ++i) onCanvas += isOnCanvas(i) ? 1 : 0;
  if (onCanvas <= FEW_POINTS) return none;
  return rangesBy(scene.count,
                  (i) => (isOnCanvas(i) ? Math.floor(scene.along(i) * view.scale) : null),
                  (i) => scene.deviation(i));
}

/** As large as the distance of neighbours allows. */
export function dotSize({scene, view}, visible) {
  const gaps = [];
  const step = Math.max(1, Math.floor(visible.length / 200));
  for (let k = 0; k < visible.length; k += step) {
    const i = visible[k];
    if (i + 1 >= scene.count) continue;
    gaps.push(Math.hypot(scene.x[i + 1] - scene.x[i], scene.y[i + 1] - scene.y[i]) * view.scale);
  }
  gaps.sort((a, b) => a - b);
  return Math.min(6, Math.max(2.4, 0.65 * (gaps[gaps.length >> 1] ?? 10)));
}

/**
 * Draws the points of a contour drawing: dots on lines, squares on arcs, crosses outside; of very
 * many the range in each pixel along the contour.
 * @return whether any is on the canvas
 */
export function paintPoints(drawing) {
  const {lowest, highest} = drawing.thinned();
  if (lowest.length === 0) return paintEachPoint(drawing);
  paintBars(drawing, lowest, highest);
  return true;
}

function paintEachPoint(drawing) {
  const {context, scene, colors} = drawing;
  const visible = visiblePoints(drawing);
  if (scene.times !== 1) paintWhiskers(drawing, visible);
  const size = dotSize(drawing, visible);
  const isCoarse = visible.length > FEW_POINTS;
  const outside = [];
  context.fillStyle = colors.point;
  context.beginPath();
  for (const i of visible) {
    if (scene.isOutside(i)) {
      outside.push(i);
      continue;
    }
    const [x, y] = drawing.pixelOf(i);
    if (isCoarse || scene.isOnArc(i)) {
      const side = 0.88 * size;
      context.rect(x - 0.5 * side, y - 0.5 * side, side, side);
    } else {
      context.moveTo(x + 0.5 * size, y);
      context.arc(x, y, 0.5 * size, 0, 2 * Math.PI);
    }
  }
  context.fill();
  paintCrosses(drawing, outside);
  return visible.length > 0;
}

const BAR_WIDTH = 1.6;  // pixels: neighbours a pixel apart leave no gap

/** A bar from the outermost on one side to the outermost on the other. */
function paintBars(drawing, lowest, highest) {
  const {context, scene, view} = drawing;
  if (scene.times !== 1) paintWhiskers(drawing, [...lowest, ...highest]);
  context.strokeStyle = drawing.colors.point;
  context.lineWidth = BAR_WIDTH;
  context.lineCap = 'round';
  context.beginPath();
  lowest.forEach((low, k) => {
    const [x, y] = drawing.pixelOf(low);
    context.moveTo(x, y);
    // A round cap is drawn for a line of some length only.
    context.lineTo(...(highest[k] === low ? [x + 0.1, y] : drawing.pixelOf(highest[k])));
  });
  context.stroke();
  context.lineCap = 'butt';
  const free = new Occupancy(view.width, view.height, 2);
  paintCrosses(drawing, scene.outside.filter((i) => free.take(...drawing.pixelOf(i))));
}

function paintCrosses(drawing, points) {
  const {context} = drawing;
  context.strokeStyle = drawing.colors.outside;
  context.lineWidth = 1.3;
  context.beginPath();
  for (const i of points) cross(context, drawing.pixelOf(i), 3.5);
  context.stroke();
}

/** Thin lines from the contour to the magnified points. */
function paintWhiskers(drawing, visible) {
  const {context, scene, view} = drawing;
  const cell = visible.length > FEW_POINTS ? 2 : 0.5;
  const sides = [new Occupancy(view.width, view.height, cell),
                 new Occupancy(view.width, view.height, cell)];
  context.strokeStyle = drawing.colors.whisker;
  context.lineWidth = 0.7;
  context.beginPath();
  for (const i of visible) {
    const x = view.px(scene.footX[i]), y = view.py(scene.footY[i]);
    if (!sides[scene.deviation(i) > 0 ? 1 : 0].take(x, y)) continue;
    context.moveTo(x, y);
    context.lineTo(...drawing.pixelOf(i));
  }
  context.stroke();
}
