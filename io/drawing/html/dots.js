// The points in the diagram of the deviations.

import {cross} from './marks.js';
import {FEW_POINTS, Occupancy} from './scene.js';
import {rangesBy} from './thinning.js';

/** Draws the points of the diagram: dots, or of very many the range in each column of pixels. */
export function paintDots(diagram) {
  const {lowest, highest} = diagram.thinned();
  if (lowest.length === 0) paintEachDot(diagram);
  else paintColumns(diagram, lowest, highest);
}

/** Whether a point lies in the stretch of the contour that the diagram shows. */
function isInView(diagram, i) {
  const along = diagram.scene.along(i);
  return along >= diagram.from && along <= diagram.to;
}

/** For each column of pixels what reaches lowest and highest; nothing while few are in view. */
export function columnRanges(diagram) {
  const {scene, values} = diagram;
  let inView = 0;
  for (let i = 0; i < scene.count; ++i) inView += isInView(diagram, i) ? 1 : 0;
  if (inView <= FEW_POINTS) return {lowest: [], highest: []};
  const columnOf = (i) => (isInView(diagram, i) ? Math.floor(diagram.px(scene.along(i))) : null);
  return rangesBy(scene.count, columnOf, (i) => values[i]);
}

function paintEachDot(diagram) {
  const {scene} = diagram;
  const free = new Occupancy(diagram.width, diagram.height, 0.25);
  const kinds = {line: [], arc: [], outside: []};
  for (let i = 0; i < scene.count; ++i) {
    if (!isInView(diagram, i)) continue;
    const [x, y] = diagram.pixelOf(i);
    if (!free.take(x, y)) continue;
    kinds[scene.isOutside(i) ? 'outside' : scene.isOnArc(i) ? 'arc' : 'line'].push([x, y]);
  }
  const count = kinds.line.length + kinds.arc.length;
  const room = 0.7 * diagram.plotWidth / Math.max(1, count);
  const size = Math.min(5, Math.max(count > 2000 ? 1.8 : 3, room));
  const {context, colors} = diagram;
  context.fillStyle = colors.line;
  context.beginPath();
  for (const [x, y] of kinds.line) {
    context.moveTo(x + 0.5 * size, y);
    context.arc(x, y, 0.5 * size, 0, 2 * Math.PI);
  }
  context.fill();
  context.fillStyle = colors.arc;
  context.beginPath();
  const side = 0.9 * size;
  for (const [x, y] of kinds.arc) context.rect(x - 0.5 * side, y - 0.5 * side, side, side);
  context.fill();
  paintOutsideDots(diagram, kinds.outside);
}

const LEAST_BAR = 1.8;  // pixels

/** A bar from the lowest to the highest of each column, and crosses over it. */
function paintColumns(diagram, lowest, highest) {
  const {context, colors, scene} = diagram;
  for (const kind of ['line', 'arc']) {
    context.fillStyle = colors[kind];
    context.beginPath();
    lowest.forEach((low, k) => {
      if (scene.isOnArc(low) !== (kind === 'arc')) return;
      const [x, bottom] = diagram.pixelOf(low);
      const top = diagram.pixelOf(highest[k])[1];
      context.rect(Math.floor(x), top - 0.5 * LEAST_BAR, 1, bottom - top + LEAST_BAR);
    });
    context.fill();
  }
  const free = new Occupancy(diagram.width, diagram.height, 2);
  paintOutsideDots(diagram, scene.outside.filter((i) => isInView(diagram, i))
    .map((i) => diagram.pixelOf(i)).filter(([x, y]) => free.take(x, y)));
}

function paintOutsideDots(diagram, places) {
  const {context} = diagram;
  context.strokeStyle = diagram.colors.outside;
  context.lineWidth = 1.2;
  context.beginPath();
  for (const place of places) cross(context, place, 3);
  context.stroke();
}
