// Places on pieces, the map from the plane to the canvas, and the search for the nearest point.

/** The place of a piece at this length from its start. */
export function placeOn(piece, along) {
  const part = piece.length > 0 ? along / piece.length : 0;
  if (piece.kind === 'arc') {
    const turn = part * piece.sweep;
    const angle = piece.startAngle + (piece.ccw ? turn : -turn);
    return [piece.center[0] + piece.radius * Math.cos(angle),
            piece.center[1] + piece.radius * Math.sin(angle)];
  }
  return [piece.start[0] + part * (piece.end[0] - piece.start[0]),
          piece.start[1] + part * (piece.end[1] - piece.start[1])];
}

/** The box around a piece: [xMin, yMin, xMax, yMax]. */
export function boxOf(piece) {
  const box = [Infinity, Infinity, -Infinity, -Infinity];
  const steps = piece.kind === 'arc' ? 32 : 1;
  for (let i = 0; i <= steps; ++i) include(box, ...placeOn(piece, piece.length * i / steps));
  include(box, ...piece.start);
  include(box, ...piece.end);
  return box;
}

export function include(box, x, y) {
  if (!Number.isFinite(x) || !Number.isFinite(y)) return;
  box[0] = Math.min(box[0], x);
  box[1] = Math.min(box[1], y);
  box[2] = Math.max(box[2], x);
  box[3] = Math.max(box[3], y);
}

/** Maps the plane to the canvas: one scale, y up, the middle of the canvas at (x, y). */
export class View {
  constructor() {
    this.x = 0;
    this.y = 0;
    this.scale = 1;
    this.width = 1;
    this.height = 1;
  }

  px(x) { return 0.5 * this.width + (x - this.x) * this.scale; }
  py(y) { return 0.5 * this.height - (y - this.y) * this.scale; }
  planeX(px) { return this.x + (px - 0.5 * this.width) / this.scale; }
  planeY(py) { return this.y - (py - 0.5 * this.height) / this.scale; }

  /** Shows the box with a margin around it, in pixels. */
  fit(box, margin) {
    const width = box[2] - box[0];
    const height = box[3] - box[1];
    const roomX = Math.max(20, this.width - 2 * margin);
    const roomY = Math.max(20, this.height - 2 * margin);
    const scale = Math.min(width > 0 ? roomX / width : Infinity,
                           height > 0 ? roomY / height : Infinity);
    this.scale = Number.isFinite(scale) ? scale : 1;
    this.x = 0.5 * (box[0] + box[2]);
    this.y = 0.5 * (box[1] + box[3]);
  }

  /** Zooms so that the place under the pixel stays where it is. */
  zoomAt(px, py, factor) {
    const x = this.planeX(px);
    const y = this.planeY(py);
    this.scale *= factor;
    this.x = x - (px - 0.5 * this.width) / this.scale;
    this.y = y + (py - 0.5 * this.height) / this.scale;
  }

  pan(dx, dy) {
    this.x -= dx / this.scale;
    this.y += dy / this.scale;
  }
}

/**
 * Draws stretches of pieces into a path, only as far as they are near the canvas: a far zoom puts
 * the rest at pixels that a canvas no longer tells apart.
 */
export class Tracer {
  constructor(view, path, margin) {
    this.view = view;
    this.path = path;
    this.left = -margin;
    this.top = -margin;
    this.right = view.width + margin;
    this.bottom = view.height + margin;
    this.penX = NaN;
    this.penY = NaN;
    /** Length in pixels from the start of the stretch to the first place drawn. */
    this.skipped = 0;
    this.isStarted = false;
    /** Whether any of the stretches so far is near the canvas. */
    this.hasDrawn = false;
  }

  trace(piece, from = 0, to = piece.length) {
    this.isStarted = false;
    this.skipped = 0;
    if (piece.kind === 'arc' && piece.length > 0) {
      const a = from === 0 ? piece.start : placeOn(piece, from);
      const b = to === piece.length ? piece.end : placeOn(piece, to);
      // No part of more than an eighth of a turn, so that the bulge stays on one side of it.
      const parts = Math.max(1, Math.ceil(piece.sweep * (to - from) / piece.length * 4 / Math.PI));
      let start = a;
      for (let i = 1; i <= parts; ++i) {
        const along = from + (to - from) * i / parts;
        const end = i === parts ? b : placeOn(piece, along);
        this.arc(piece, from + (to - from) * (i - 1) / parts, along, start, end, 0);
        start = end;
      }
    } else {
      this.segment(from === 0 ? piece.start : placeOn(piece, from),
                   to === piece.length ? piece.end : placeOn(piece, to), (to - from));
    }
  }

  arc(piece, from, to, a, b, depth) {
    const view = this.view;
    const sweep = (to - from) / piece.radius;
    const bulge = piece.radius * (1 - Math.cos(0.5 * sweep)) * view.scale;
    const ax = view.px(a[0]), ay = view.py(a[1]), bx = view.px(b[0]), by = view.py(b[1]);
    const isAway = Math.max(ax, bx) + bulge < this.left || Math.min(ax, bx) - bulge > this.right ||
                   Math.max(ay, by) + bulge < this.top || Math.min(ay, by) - bulge > this.bottom;
    if (isAway) {
      if (!this.isStarted) this.skipped += (to - from) * view.scale;
      return;
    }
    if (bulge < 0.08 || depth > 40) {
      this.segment(a, b, to - from);
      return;
    }
    const middle = 0.5 * (from + to);
    const m = placeOn(piece, middle);
    this.arc(piece, from, middle, a, m, depth + 1);
    this.arc(piece, middle, to, m, b, depth + 1);
  }

  /** The part of a straight stretch that is near the canvas. */
  segment(a, b, length) {
    const view = this.view;
    const ax = view.px(a[0]), ay = view.py(a[1]), bx = view.px(b[0]), by = view.py(b[1]);
    const dx = bx - ax, dy = by - ay;
    let from = 0, to = 1;
    for (const [start, step, low, high] of [[ax, dx, this.left, this.right],
                                            [ay, dy, this.top, this.bottom]]) {
      if (step === 0) {
        if (start < low || start > high) to = -1;
        continue;
      }
      const first = (low - start) / step, second = (high - start) / step;
      from = Math.max(from, Math.min(first, second));
      to = Math.min(to, Math.max(first, second));
    }
    if (from > to) {
      if (!this.isStarted) this.skipped += length * view.scale;
      return;
    }
    if (!this.isStarted) this.skipped += from * length * view.scale;
    this.isStarted = true;
    this.hasDrawn = true;
    const startX = ax + from * dx, startY = ay + from * dy;
    const isJoined = Math.abs(startX - this.penX) < 1e-3 && Math.abs(startY - this.penY) < 1e-3;
    if (!isJoined) this.path.moveTo(startX, startY);
    this.penX = ax + to * dx;
    this.penY = ay + to * dy;
    this.path.lineTo(this.penX, this.penY);
  }
}

/** Finds the nearest of many places quickly. */
export class PointGrid {
  constructor(x, y) {
    this.x = x;
    this.y = y;
    const box = [Infinity, Infinity, -Infinity, -Infinity];
    for (let i = 0; i < x.length; ++i) include(box, x[i], y[i]);
    if (x.length === 0) include(box, 0, 0);
    this.left = box[0];
    this.bottom = box[1];
    const width = box[2] - box[0], height = box[3] - box[1];
    this.cell = Math.max(width, height) / Math.max(1, Math.min(512, Math.sqrt(x.length))) || 1;
    this.columns = Math.floor(width / this.cell) + 1;
    this.rows = Math.floor(height / this.cell) + 1;
    this.sort();
  }

  column(x) {
    return Math.min(this.columns - 1, Math.max(0, Math.floor((x - this.left) / this.cell)));
  }

  row(y) { return Math.min(this.rows - 1, Math.max(0, Math.floor((y - this.bottom) / this.cell))); }

  /** Puts the points of each cell side by side. */
  sort() {
    const cellOf = (i) => this.row(this.y[i]) * this.columns + this.column(this.x[i]);
    this.begin = new Uint32Array(this.columns * this.rows + 1);
    for (let i = 0; i < this.x.length; ++i) ++this.begin[cellOf(i) + 1];
    for (let i = 1; i < this.begin.length; ++i) this.begin[i] += this.begin[i - 1];
    const next = this.begin.slice();
    this.points = new Uint32Array(this.x.length);
    for (let i = 0; i < this.x.length; ++i) this.points[next[cellOf(i)]++] = i;
  }

  /** The nearest point no farther than `reach`, or -1; the first of several. */
  nearest(x, y, reach) {
    let found = -1;
    let least = reach * reach;
    this.visit([x - reach, y - reach, x + reach, y + reach], (i) => {
      const distance = (this.x[i] - x) ** 2 + (this.y[i] - y) ** 2;
      if (distance < least || (distance === least && (found < 0 || i < found))) {
        least = distance;
        found = i;
      }
    });
    return found;
  }

  /** Calls for each point of the cells that the box touches, in no order. */
  visit([left, bottom, right, top], action) {
    const lastRow = this.row(top), lastColumn = this.column(right);
    for (let row = this.row(bottom); row <= lastRow; ++row) {
      for (let column = this.column(left); column <= lastColumn; ++column) {
        const cell = row * this.columns + column;
        for (let k = this.begin[cell]; k < this.begin[cell + 1]; ++k) action(this.points[k]);
      }
    }
  }
}

/** Length from the start of the piece to its place nearest to (x, y). */
export function footOn(piece, x, y) {
  if (piece.kind === 'arc') {
    const angle = Math.atan2(y - piece.center[1], x - piece.center[0]);
    let turn = (piece.ccw ? angle - piece.startAngle : piece.startAngle - angle) % (2 * Math.PI);
    if (turn < 0) turn += 2 * Math.PI;
    if (turn <= piece.sweep) return turn * piece.radius;
    const toStart = Math.hypot(x - piece.start[0], y - piece.start[1]);
    return toStart <= Math.hypot(x - piece.end[0], y - piece.end[1]) ? 0 : piece.length;
  }
  const dx = piece.end[0] - piece.start[0], dy = piece.end[1] - piece.start[1];
  const length2 = dx * dx + dy * dy;
  if (!(length2 > 0)) return 0;
  const part = ((x - piece.start[0]) * dx + (y - piece.start[1]) * dy) / length2;
  return Math.min(1, Math.max(0, part)) * piece.length;
}

/** Distance in the plane from a place to a piece. */
export function distanceTo(piece, x, y) {
  const [footX, footY] = placeOn(piece, footOn(piece, x, y));
  return Math.hypot(x - footX, y - footY);
}
