// What is drawn: the data of the page and what follows from it and the magnification.

import {placeOn, boxOf, include, PointGrid, distanceTo} from './geometry.js';

/** A place is taken by the first mark that falls on it; later ones would not be seen. */
export class Occupancy {
  constructor(width, height, cell) {
    this.cell = cell;
    this.columns = Math.ceil(width / cell) + 1;
    this.rows = Math.ceil(height / cell) + 1;
    this.taken = new Uint8Array(this.columns * this.rows);
  }

  /** Whether the place is on the canvas and was free. */
  take(px, py) {
    const column = Math.floor(px / this.cell), row = Math.floor(py / this.cell);
    if (!(column >= 0 && row >= 0 && column < this.columns && row < this.rows)) return false;
    const at = row * this.columns + column;
    if (this.taken[at]) return false;
    this.taken[at] = 1;
    return true;
  }
}

/** So many points may have true shapes and lines to the contour. */
export const FEW_POINTS = 4000;

/** The largest relative deviation that counts as within tolerance, as everywhere here. */
export const LARGEST_RELATIVE = 1 + 1e-6;

export class Scene {
  constructor(data) {
    Object.assign(this, data);
    this.count = data.points.x.length;
    this.hasContour = data.pieces.length > 0;
    /** Whether there are points and a contour that they were measured against. */
    this.isMeasured = this.hasContour && this.count > 0;
    this.hasTolerances = data.points.w !== null;
    this.starts = [0];
    for (const piece of this.pieces) this.starts.push(this.starts.at(-1) + piece.length);
    this.length = this.starts.at(-1);
    if (this.isMeasured) this.findFeet();
    this.countPoints();
    this.setMagnify(1);
  }

  tolerance(i) {
    const w = this.points.w;
    return w === null ? null : (Array.isArray(w) ? w[i] : w);
  }

  get isToleranceUniform() { return !Array.isArray(this.points.w); }

  get largestTolerance() {
    const w = this.points.w;
    return Array.isArray(w) ? w.reduce((a, b) => Math.max(a, b), 0) : w ?? 0;
  }

  get smallestTolerance() {
    const w = this.points.w;
    return Array.isArray(w) ? w.reduce((a, b) => Math.min(a, b), Infinity) : w ?? 0;
  }

  /** Whether the part is much higher than it is wide. */
  get isTall() {
    const box = this.box();
    return box[3] - box[1] > 1.3 * (box[2] - box[0]);
  }

  deviation(i) { return this.deviations.signed[i]; }
  relative(i) { return this.hasTolerances ? this.deviation(i) / this.tolerance(i) : null; }
  isOutside(i) {
    return this.hasTolerances && !(Math.abs(this.relative(i)) <= LARGEST_RELATIVE);
  }
  pieceOf(i) { return this.deviations.piece[i]; }
  isOnArc(i) { return this.hasContour && this.pieces[this.pieceOf(i)].kind === 'arc'; }
  /** Length along the whole contour of the place nearest to the point. */
  along(i) { return this.starts[this.pieceOf(i)] + this.deviations.along[i]; }

  findFeet() {
    this.footX = new Float64Array(this.count);
    this.footY = new Float64Array(this.count);
    for (let i = 0; i < this.count; ++i) {
      const foot = placeOn(this.pieces[this.pieceOf(i)], this.deviations.along[i]);
      [this.footX[i], this.footY[i]] = foot;
    }
  }

  /** How many points each piece has and the worst of them. */
  countPoints() {
    for (const piece of this.pieces) Object.assign(piece, {points: 0, worst: -1});
    if (!this.isMeasured) return;
    const size = (i) => Math.abs(this.hasTolerances ? this.relative(i) : this.deviation(i));
    for (let i = 0; i < this.count; ++i) {
      const piece = this.pieces[this.pieceOf(i)];
      ++piece.points;
      if (piece.worst < 0 || size(i) > size(piece.worst)) piece.worst = i;
    }
  }

  /** Moves every point away from its foot until it is `times` as far from it. */
  setMagnify(times) {
    this.times = this.isMeasured ? times : 1;
    const {x, y} = this.points;
    this.x = Float64Array.from(x);
    this.y = Float64Array.from(y);
    if (this.times !== 1) {
      for (let i = 0; i < this.count; ++i) {
        this.x[i] = this.footX[i] + times * (x[i] - this.footX[i]);
        this.y[i] = this.footY[i] + times * (y[i] - this.footY[i]);
      }
    }
    this.grid = new PointGrid(this.x, this.y);
  }

  /** Round magnifications up to ten times the one given, which is among them. */
  magnifications() {
    const steps = new Set([1, this.magnify]);
    for (let power = 1; power <= 10 * this.magnify; power *= 10) {
      for (const factor of [1, 2, 5]) {
        if (factor * power <= 10 * this.magnify) steps.add(factor * power);
      }
    }
    return [...steps].sort((a, b) => a - b);
  }

  /** A box around everything, without what strays far from the points where there are any. */
  box() {
    if (this.count === 0) {
      const box = [Infinity, Infinity, -Infinity, -Infinity];
      for (const [xMin, yMin, xMax, yMax] of this.pieces.map(boxOf)) {
        include(box, xMin, yMin);
        include(box, xMax, yMax);
      }
      return box;
    }
    const points = [Infinity, Infinity, -Infinity, -Infinity];
    for (let i = 0; i < this.count; ++i) include(points, this.points.x[i], this.points.y[i]);
    const reach = 0.5 * Math.max(points[2] - points[0], points[3] - points[1]);
    const box = points.slice();
    const clamp = (value, low, high) => Math.min(high, Math.max(low, value));
    const add = (x, y) => include(box, clamp(x, points[0] - reach, points[2] + reach),
                                  clamp(y, points[1] - reach, points[3] + reach));
    for (const piece of this.pieces) {
      const own = boxOf(piece);
      add(own[0], own[1]);
      add(own[2], own[3]);
    }
    for (let i = 0; i < this.count; ++i) add(this.x[i], this.y[i]);
    return box;
  }

  /** The piece no farther than `reach` from the place, or -1. */
  pieceNear(x, y, reach) {
    let found = -1;
    let least = reach;
    this.pieces.forEach((piece, i) => {
      const distance = distanceTo(piece, x, y);
      if (distance < least) [least, found] = [distance, i];
    });
    return found;
  }
}
