// The grid of the drawing and the numbers along its edges.

import {ticksBetween} from './numbers.js';

/** Where the lines of the grid run: some 90 pixels apart along x, 70 along y. */
export function gridTicks(view) {
  return {
    columns: ticksBetween(view.planeX(0), view.planeX(view.width), 90 / view.scale),
    rows: ticksBetween(view.planeY(view.height), view.planeY(0), 70 / view.scale),
  };
}

export function paintGrid(context, view, ticks, color) {
  context.strokeStyle = color;
  context.lineWidth = 1;
  context.beginPath();
  for (const {value} of ticks.columns) {
    context.moveTo(view.px(value), 0);
    context.lineTo(view.px(value), view.height);
  }
  for (const {value} of ticks.rows) {
    context.moveTo(0, view.py(value));
    context.lineTo(view.width, view.py(value));
  }
  context.stroke();
}

/** The numbers keep clear of the corners, where the names of the axes stand. */
export function paintAxisLabels(context, view, ticks, {colors, units}) {
  context.font = '11px system-ui, "DejaVu Sans", sans-serif';
  const halo = (text, x, y) => {
    context.lineWidth = 3;
    context.strokeStyle = colors.paper;
    context.lineJoin = 'round';
    context.strokeText(text, x, y);
    context.fillStyle = colors.soft;
    context.fillText(text, x, y);
  };
  context.textAlign = 'center';
  for (const {value, label} of ticks.columns) {
    const x = view.px(value);
    if (x > 50 && x < view.width - 80) halo(label, x, view.height - 6);
  }
  context.textAlign = 'left';
  for (const {value, label} of ticks.rows) {
    const y = view.py(value);
    if (y > 30 && y < view.height - 22) halo(label, 6, y + 4);
  }
  const suffix = units ? ` [${units}]` : '';
  halo(`y${suffix}`, 6, 16);
  context.textAlign = 'right';
  halo(`x${suffix}`, view.width - 8, view.height - 6);
}
