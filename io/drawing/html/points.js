// The measured points in the drawing of the contour.

import {cross} from './marks.js';
import {FEW_POINTS, Occupancy} from './scene.js';

/** The points on the canvas that are not hidden behind others. */
export function visiblePoints({scene, view}) {
  const free = new Occupancy(view.width, view.height, scene.count > FEW_POINTS ? 1 : 0.25);
  const visible = [];
  for (let i = 0; i < scene.count; ++i) {
    if (free.take(view.px(scene.x[i]), view.py(scene.y[i]))) visible.push(i);
  }
  return visible;
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
 * Draws the points of a contour drawing: dots on lines, squares on arcs, crosses outside.
 * @return those that are on the canvas and not hidden
 */
export function paintPoints(drawing) {
  const {context, scene, colors} = drawing;
  const visible = visiblePoints(drawing);
  if (scene.times !== 1) paintWhiskers(drawing, visible);
  const size = dotSize(drawing, visible);
  const isCoarse = visible.length > FEW_POINTS;
  const outside = [];
  context.fillStyle = colors.point;
  context.beginPath();
  for (const i of visible) {
    if (scene.hasContour && scene.isOutside(i)) {
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
  return visible;
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
