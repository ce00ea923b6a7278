// The drawing of the contour: true to scale, deviations and tolerance magnified.

import {gridTicks, paintAxisLabels, paintGrid} from './axes.js';
import {placeOn, boxOf, View, Tracer} from './geometry.js';
import {bandPaths} from './band.js';
import {arrow, ring, square} from './marks.js';
import {paintPoints, pointRanges} from './points.js';
import {FEW_POINTS, Occupancy} from './scene.js';
import {PAPER_WIDTH, Surface} from './surface.js';
import {Remembered} from './thinning.js';

/** Pixels of a piece with its number beside it. */
const LEAST_LABEL_ROOM = 34;

export class ContourDrawing {
  constructor(canvas, scene, state) {
    this.scene = scene;
    this.state = state;
    this.view = new View();
    this.isFresh = true;
    this.ranges = new Remembered();
    const paper = [PAPER_WIDTH, scene.isMeasured && !scene.isTall ? 325 : 529];
    this.surface = new Surface(canvas, paper, (...page) => this.paint(...page));
  }

  showAll() {
    this.view.fit(this.scene.box(), 34);
    this.isUntouched = true;
    this.surface.schedule();
  }

  showPiece(index) {
    const box = boxOf(this.scene.pieces[index]);
    this.isUntouched = false;
    this.view.fit(box, Math.min(120, 0.25 * Math.min(this.view.width, this.view.height)));
    this.surface.schedule();
  }

  zoom(px, py, factor) {
    this.isUntouched = false;
    this.view.zoomAt(px, py, factor);
    this.surface.schedule();
  }

  pan(dx, dy) {
    this.isUntouched = false;
    this.view.pan(dx, dy);
    this.surface.schedule();
  }

  /** Pixel of a point as drawn. */
  pixelOf(i) { return [this.view.px(this.scene.x[i]), this.view.py(this.scene.y[i])]; }

  /** The points that stand for all of very many, for as long as the view stays. */
  thinned() {
    const {x, y, scale, width, height} = this.view;
    return this.ranges.get([x, y, scale, width, height, this.scene.times].join(),
                           () => pointRanges(this));
  }

  pointAt(px, py, reach) {
    const view = this.view;
    return this.scene.grid.nearest(view.planeX(px), view.planeY(py), reach / view.scale);
  }

  pieceAt(px, py, reach) {
    const view = this.view;
    return this.scene.pieceNear(view.planeX(px), view.planeY(py), reach / view.scale);
  }

  paint(context, width, height, colors) {
    [this.view.width, this.view.height] = [width, height];
    if (this.isFresh || this.isUntouched) this.view.fit(this.scene.box(), 34);
    if (this.isFresh) this.isUntouched = true;
    this.isFresh = false;
    [this.context, this.colors] = [context, colors];
    context.fillStyle = colors.paper;
    context.fillRect(0, 0, width, height);
    const ticks = gridTicks(this.view);
    paintGrid(context, this.view, ticks, colors.grid);
    if (this.scene.hasTolerances) this.paintBand();
    if (!this.scene.hasContour) this.paintOrder();
    // So many points would hide the contour.
    const areMany = this.scene.count > FEW_POINTS;
    if (!areMany) this.paintPieces();
    const isPointVisible = paintPoints(this);
    if (areMany) this.paintPieces();
    this.paintJoints();
    this.paintEnds();
    if (this.scene.isMeasured) this.paintWorst();
    if (this.scene.hasContour) this.paintNumbers();
    this.paintHovered();
    paintAxisLabels(context, this.view, ticks, {colors, units: this.scene.units});
    this.onPainted?.(isPointVisible || this.isPieceVisible());
  }

  /** Whether any piece runs through the canvas. */
  isPieceVisible() {
    return this.scene.pieces.some((piece) => {
      const tracer = new Tracer(this.view, {moveTo() {}, lineTo() {}}, 0);
      tracer.trace(piece);
      return tracer.hasDrawn;
    });
  }

  paintBand() {
    const {context, scene, view, colors} = this;
    if (2 * scene.times * scene.largestTolerance * view.scale < 1) return;
    if (!scene.hasContour) {
      this.paintDiscs();
      return;
    }
    const paths = bandPaths(scene, view);
    context.lineJoin = 'round';
    context.lineCap = 'butt';
    for (const [extra, color] of [[1.6, colors['band-edge']], [0, colors.band]]) {
      context.strokeStyle = color;
      for (const [width, {path}] of paths) {
        context.lineWidth = width + extra;
        context.stroke(path);
      }
    }
  }

  /** Without a contour the tolerance is a disc about each point. */
  paintDiscs() {
    const {context, scene, view, colors} = this;
    const free = new Occupancy(view.width, view.height, 0.5);
    const discs = [];
    for (let i = 0; i < scene.count; ++i) {
      const [x, y] = this.pixelOf(i);
      if (free.take(x, y)) discs.push([x, y, scene.tolerance(i) * view.scale]);
    }
    for (const [extra, color] of [[0.8, colors['band-edge']], [0, colors.band]]) {
      context.fillStyle = color;
      context.beginPath();
      for (const [x, y, radius] of discs) {
        context.moveTo(x + radius + extra, y);
        context.arc(x, y, radius + extra, 0, 2 * Math.PI);
      }
      context.fill();
    }
  }

  paintPieces() {
    const {context, scene, view, colors, state} = this;
    context.lineCap = 'butt';
    context.lineJoin = 'round';
    const stroke = (index, color, width, dashes) => {
      const path = new Path2D();
      const tracer = new Tracer(view, path, 30);
      tracer.trace(scene.pieces[index]);
      context.strokeStyle = color;
      context.lineWidth = width;
      context.setLineDash(dashes);
      // Dashes stay where they are on the piece while the view moves.
      context.lineDashOffset = tracer.skipped;
      context.stroke(path);
    };
    for (const index of [state.chosen, state.hoveredPiece]) {
      if (index >= 0) stroke(index, colors.chosen, 9, []);
    }
    scene.pieces.forEach((piece, i) => {
      const isArc = piece.kind === 'arc';
      stroke(i, isArc ? colors.arc : colors.line, 2, isArc ? [10, 2.5] : []);
    });
    context.setLineDash([]);
  }

  paintJoints() {
    const {context, scene, view, colors} = this;
    const free = new Occupancy(view.width, view.height, 1);
    const radius = scene.pieces.length > 60 ? 2.6 : 3.6;
    context.fillStyle = colors.paper;
    context.strokeStyle = colors.text;
    context.lineWidth = 1.1;
    context.beginPath();
    for (const piece of scene.pieces.slice(1)) {
      const x = view.px(piece.start[0]), y = view.py(piece.start[1]);
      if (!free.take(x, y)) continue;
      context.moveTo(x + radius, y);
      context.arc(x, y, radius, 0, 2 * Math.PI);
    }
    context.fill();
    context.stroke();
  }

  /** A triangle at the start that points ahead, a square at the end. */
  paintEnds() {
    const {context, scene, view, colors} = this;
    const last = scene.count - 1;
    let start = [scene.x[0], scene.y[0]];
    let end = [scene.x[last], scene.y[last]];
    let ahead = null;
    if (scene.hasContour) {
      const first = scene.pieces[0];
      start = first.start;
      end = scene.pieces.at(-1).end;
      ahead = placeOn(first, Math.min(first.length, 11 / view.scale));
    } else {
      ahead = this.placeAhead(0, 11);
    }
    if (!scene.isClosed) square(context, colors, [view.px(end[0]), view.py(end[1])], 8);
    const x = view.px(start[0]), y = view.py(start[1]);
    arrow(context, colors, [x, y], [view.px(ahead[0]) - x, view.py(ahead[1]) - y], 12, true);
  }

  /** The first point that is some pixels away from point i. */
  placeAhead(i, distance) {
    const {scene, view} = this;
    const x = scene.x[i], y = scene.y[i];
    let k = i + 1;
    while (k < scene.count - 1 &&
           Math.hypot(scene.x[k] - x, scene.y[k] - y) * view.scale < distance) ++k;
    return [scene.x[Math.min(k, scene.count - 1)], scene.y[Math.min(k, scene.count - 1)]];
  }

  /** Small arrows to the right of the points' sense of travel: nothing joins the points. */
  paintOrder() {
    const {context, scene, view, colors} = this;
    const drawn = [];
    const step = Math.max(1, Math.floor(scene.count / 400));
    for (let i = 0; i + 1 < scene.count; i += step) {
      const [x, y] = this.pixelOf(i);
      if (x < 0 || y < 0 || x > view.width || y > view.height) continue;
      if (drawn.some((other) => Math.hypot(other[0] - x, other[1] - y) < 90)) continue;
      const ahead = this.placeAhead(i, 16);
      const dx = view.px(ahead[0]) - x, dy = view.py(ahead[1]) - y;
      const length = Math.hypot(dx, dy);
      if (length < 8) continue;
      drawn.push([x, y]);
      const tailX = x - 12 * dy / length, tailY = y + 12 * dx / length;
      context.strokeStyle = colors.start;
      context.lineWidth = 1.3;
      context.beginPath();
      context.moveTo(tailX, tailY);
      context.lineTo(tailX + 12 * dx / length, tailY + 12 * dy / length);
      context.stroke();
      const tip = [tailX + 11 * dx / length, tailY + 11 * dy / length];
      arrow(context, colors, tip, [dx, dy], 7, false);
    }
  }

  paintWorst() { ring(this.context, this.pixelOf(this.scene.worst), 8, this.colors.worst); }

  /** The number of each piece beside its middle, where there is room. */
  paintNumbers() {
    const {context, scene, view, colors} = this;
    const taken = [];
    const band = scene.hasTolerances ? scene.times * scene.largestTolerance * view.scale : 0;
    const aside = 13 + Math.min(band, 60);
    context.font = '600 11px system-ui, "DejaVu Sans", sans-serif';
    context.textAlign = 'center';
    scene.pieces.forEach((piece, i) => {
      if (piece.length * view.scale < LEAST_LABEL_ROOM) return;
      const at = placeOn(piece, 0.5 * piece.length);
      const next = placeOn(piece, 0.5 * piece.length + 1e-3 * piece.length);
      const dx = next[0] - at[0], dy = next[1] - at[1];
      const length = Math.hypot(dx, dy) || 1;
      // To the left of travel, but outside an arc.
      const side = piece.kind === 'arc' && piece.ccw ? -1 : 1;
      const x = view.px(at[0]) - side * aside * dy / length;
      const y = view.py(at[1]) - side * aside * dx / length;
      if (taken.some((other) => Math.abs(other[0] - x) < 22 && Math.abs(other[1] - y) < 14)) return;
      taken.push([x, y]);
      context.lineWidth = 3;
      context.strokeStyle = colors.paper;
      context.strokeText(String(i + 1), x, y + 4);
      context.fillStyle = piece.kind === 'arc' ? colors.arc : colors.line;
      context.fillText(String(i + 1), x, y + 4);
    });
  }

  paintHovered() {
    const i = this.state.hovered;
    if (i < 0) return;
    ring(this.context, this.pixelOf(i), 5, this.colors.text);
  }
}
