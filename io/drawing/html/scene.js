// What is drawn: the data of the page and what follows from it and the magnification.

import {placeOn, boxOf, include, PointGrid, distanceTo, footOn} from './geometry.js';
import {unpacked} from './packed.js';

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

export class Scene {
  constructor(data) {
    Object.assign(this, data);
    this.unpack(data);
    this.count = this.points.x.length;
    this.hasContour = data.pieces.length > 0;
    /** Whether there are points and a contour that they were measured against. */
    this.isMeasured = this.hasContour && this.count > 0;
    this.hasTolerances = data.points.w !== null;
    this.findTolerances();
    this.starts = [0];
    for (const piece of this.pieces) this.starts.push(this.starts.at(-1) + piece.length);
    this.length = this.starts.at(-1);
    if (this.isMeasured) this.findFeet();
    this.countPoints();
    this.setMagnify(1);
  }

  /** Numbers by point, and what packed ones keep exactly. */
  unpack({points, deviations}) {
    const columns = (table, names) => Object.fromEntries(
      names.map((name) => [name, unpacked(table[name])]));
    /** What packed coordinates are a multiple of; 0 for exact ones. */
    this.step = points.x.bytes ? Number(`1e${-Math.min(points.x.decimals, points.y.decimals)}`) : 0;
    this.points = columns(points, ['x', 'y', 'w']);
    this.outside = deviations?.outside ?? [];
    if (!deviations) return;
    this.deviations = columns(deviations, ['signed', 'piece']);
    const {exact} = deviations;
    exact?.index.forEach((i, k) => {
      this.deviations.signed[i] = exact.signed[k];
      if (typeof this.points.w === 'object') this.points.w[i] = exact.w[k];
    });
  }

  findTolerances() {
    const {w} = this.points;
    this.isToleranceUniform = w === null || typeof w === 'number';
    this.largestTolerance = this.isToleranceUniform ? w ?? 0
                                                    : w.reduce((a, b) => Math.max(a, b), 0);
    this.smallestTolerance = this.isToleranceUniform ? w ?? 0
                                                     : w.reduce((a, b) => Math.min(a, b), Infinity);
    this.outsideFlags = new Uint8Array(this.count);
    for (const i of this.outside) this.outsideFlags[i] = 1;
  }

  tolerance(i) { return this.isToleranceUniform ? this.points.w : this.points.w[i]; }

  /** Whether the part is much higher than it is wide. */
  get isTall() {
    const box = this.box();
    return box[3] - box[1] > 1.3 * (box[2] - box[0]);
  }

  deviation(i) { return this.deviations.signed[i]; }
  relative(i) { return this.hasTolerances ? this.deviation(i) / this.tolerance(i) : null; }
  isOutside(i) { return this.outsideFlags[i] === 1; }
  pieceOf(i) { return this.deviations.piece[i]; }
  isOnArc(i) { return this.hasContour && this.pieces[this.pieceOf(i)].kind === 'arc'; }
  /** Length along the whole contour of the place nearest to the point. */
  along(i) { return this.alongs[i]; }

  findFeet() {
    this.footX = new Float64Array(this.count);
    this.footY = new Float64Array(this.count);
    this.alongs = new Float64Array(this.count);
    const {x, y} = this.points;
    for (let i = 0; i < this.count; ++i) {
      const index = this.pieceOf(i);
      const along = footOn(this.pieces[index], x[i], y[i]);
      [this.footX[i], this.footY[i]] = placeOn(this.pieces[index], along);
      this.alongs[i] = this.starts[index] + along;
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
    this.madeGrid = null;
    this.madeBox = null;
  }

  /** Of the points as drawn. */
  get grid() {
    this.madeGrid ??= new PointGrid(this.x, this.y);
    return this.madeGrid;
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
    this.madeBox ??= this.makeBox();
    return this.madeBox;
  }

  makeBox() {
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
