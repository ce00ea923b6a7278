// The deviations along the contour, positive to the left of the direction of travel.

import {columnRanges, paintDots} from './dots.js';
import {PointGrid} from './geometry.js';
import {ring} from './marks.js';
import {ticksBetween} from './numbers.js';
import {PAPER_WIDTH, Surface} from './surface.js';
import {Remembered} from './thinning.js';

const PLOT = {left: 72, right: 16, top: 26, bottom: 36};
const STRIP = 14;

/** Width of the histogram beside the diagram with the gap between them, on paper in pixels. */
const HISTOGRAM_ON_PAPER = 235;

export class Diagram {
  constructor(canvas, scene, state) {
    this.scene = scene;
    this.state = state;
    this.isRelative = scene.hasTolerances && !scene.isToleranceUniform;
    this.values = new Float64Array(scene.count);
    this.ranges = new Remembered();
    [this.from, this.to] = [0, scene.length];
    this.setRelative(this.isRelative);
    this.surface = new Surface(canvas, [PAPER_WIDTH - HISTOGRAM_ON_PAPER, 174],
                               (...page) => this.paint(...page));
  }

  setRelative(isRelative) {
    const scene = this.scene;
    this.isRelative = isRelative;
    for (let i = 0; i < scene.count; ++i) {
      this.values[i] = isRelative ? scene.relative(i) : scene.deviation(i);
    }
    this.limit = !scene.hasTolerances ? 0 : isRelative ? 1 : scene.largestTolerance;
    let largest = 0;
    for (const value of this.values) largest = Math.max(largest, Math.abs(value) || 0);
    this.range = Math.max(1.3 * this.limit, 1.15 * largest) || 1;
    this.surface?.schedule();
  }

  get plotWidth() { return this.width - PLOT.left - PLOT.right; }
  get plotHeight() { return this.height - PLOT.top - PLOT.bottom; }
  px(along) {
    return PLOT.left + this.plotWidth * (along - this.from) / (this.to - this.from || 1);
  }
  alongAt(px) { return this.from + (px - PLOT.left) / this.plotWidth * (this.to - this.from); }
  py(value) { return PLOT.top + 0.5 * this.plotHeight * (1 - value / this.range); }
  /** The points that stand for all of very many, for as long as the view stays. */
  thinned() {
    const {from, to, width, height, isRelative} = this;
    return this.ranges.get([from, to, width, height, isRelative].join(), () => columnRanges(this));
  }

  pixelOf(i) { return [this.px(this.scene.along(i)), this.py(this.values[i])]; }

  zoom(px, py, factor) {
    const share = Math.min(1, Math.max(0, (px - PLOT.left) / this.plotWidth));
    const at = this.from + share * (this.to - this.from);
    const size = Math.min(this.scene.length, Math.max(1e-9 * this.scene.length,
                                                      (this.to - this.from) / factor));
    this.show(at - share * size, size);
  }

  pan(dx) {
    const size = this.to - this.from;
    this.show(this.from - dx * size / this.plotWidth, size);
  }

  show(from, size) {
    this.from = Math.min(Math.max(0, from), this.scene.length - size);
    this.to = this.from + size;
    this.surface.schedule();
  }

  showAll() { this.show(0, this.scene.length); }

  showPiece(index) {
    const starts = this.scene.starts;
    const size = Math.min(this.scene.length, 3 * (starts[index + 1] - starts[index]));
    this.show(0.5 * (starts[index] + starts[index + 1] - size), size);
  }

  /** The points side by side along the contour, whatever their deviation. */
  get grid() {
    this.madeGrid ??= new PointGrid(this.scene.alongs, new Float64Array(this.scene.count));
    return this.madeGrid;
  }

  pointAt(px, py, reach) {
    let found = -1;
    let least = reach * reach;
    this.grid.visit([this.alongAt(px - reach), 0, this.alongAt(px + reach), 0], (i) => {
      const [x, y] = this.pixelOf(i);
      const distance = (x - px) ** 2 + (y - py) ** 2;
      if (distance < least || (distance === least && i < found)) [least, found] = [distance, i];
    });
    return found;
  }

  pieceAt(px) {
    const along = this.alongAt(px);
    if (!(along >= this.from && along <= this.to)) return -1;
    const starts = this.scene.starts;
    let low = 0, high = this.scene.pieces.length - 1;
    while (low < high) {
      const middle = (low + high + 1) >> 1;
      if (starts[middle] <= along) low = middle;
      else high = middle - 1;
    }
    return low;
  }

  paint(context, width, height, colors) {
    [this.context, this.colors, this.width, this.height] = [context, colors, width, height];
    context.fillStyle = colors.paper;
    context.fillRect(0, 0, width, height);
    context.save();
    context.beginPath();
    context.rect(PLOT.left, PLOT.top - STRIP, this.plotWidth, this.plotHeight + STRIP);
    context.clip();
    this.paintBand();
    this.paintPieces();
    paintDots(this);
    this.paintRings();
    context.restore();
    this.paintAxes();
  }

  paintBand() {
    const {context, colors} = this;
    if (this.limit > 0) {
      const top = this.py(this.limit), bottom = this.py(-this.limit);
      context.fillStyle = colors.band;
      context.strokeStyle = colors['band-edge'];
      context.lineWidth = 1.2;
      if (!this.isRelative && !this.scene.isToleranceUniform) {
        this.paintVaryingBand();
      } else {
        context.fillRect(PLOT.left, top, this.plotWidth, bottom - top);
        context.strokeRect(PLOT.left - 5, top, this.plotWidth + 10, bottom - top);
      }
    }
    context.fillStyle = colors.border;
    context.fillRect(PLOT.left, this.py(0) - 0.5, this.plotWidth, 1);
  }

  /** Limits that change along the contour. */
  paintVaryingBand() {
    const {context, scene} = this;
    const {piece, from, to, tolerance} = scene.band;
    for (const isEdge of [true, false]) {
      context.fillStyle = isEdge ? this.colors['band-edge'] : this.colors.band;
      const extra = isEdge ? 1 : 0;
      context.beginPath();
      for (let i = 0; i < piece.length; ++i) {
        const left = this.px(scene.starts[piece[i]] + from[i]);
        const right = this.px(scene.starts[piece[i]] + to[i]);
        if (right < PLOT.left || left > this.width) continue;
        const top = this.py(tolerance[i]) - extra;
        context.rect(left, top, right - left + 0.5, this.py(-tolerance[i]) + extra - top);
      }
      context.fill();
    }
  }

  /** The strip of the pieces by kind with their numbers, and the joints. */
  paintPieces() {
    const {context, scene, colors, state} = this;
    const top = PLOT.top - STRIP;
    context.font = '10.5px system-ui, "DejaVu Sans", sans-serif';
    context.textAlign = 'center';
    let before = -Infinity;
    scene.pieces.forEach((piece, i) => {
      const left = Math.max(PLOT.left, this.px(scene.starts[i]));
      const right = Math.min(this.width - PLOT.right, this.px(scene.starts[i + 1]));
      if (right < PLOT.left || left > this.width) return;
      const isMarked = i === state.chosen || i === state.hoveredPiece;
      context.fillStyle = isMarked ? colors.chosen
                                   : colors[piece.kind === 'arc' ? 'arc-tint' : 'line-tint'];
      context.fillRect(left, top, right - left, STRIP);
      context.fillStyle = colors.text;
      if (right - left > 8 + 6.5 * String(i + 1).length) {
        context.fillText(String(i + 1), 0.5 * (left + right), PLOT.top - 3.5);
      }
      if (i > 0 && left - before > 1.5) {
        context.strokeStyle = colors.whisker;
        context.lineWidth = scene.pieces.length > 60 ? 0.4 : 0.8;
        context.setLineDash([2, 3]);
        context.beginPath();
        context.moveTo(left, top);
        context.lineTo(left, this.height - PLOT.bottom);
        context.stroke();
        context.setLineDash([]);
        before = left;
      }
    });
  }

  paintRings() {
    const {context, colors} = this;
    for (const [i, radius, color] of [[this.scene.worst, 7, colors.worst],
                                      [this.state.hovered, 5, colors.text]]) {
      if (i >= 0) ring(context, this.pixelOf(i), radius, color);
    }
  }

  paintAxes() {
    const {context, colors, scene} = this;
    const bottom = this.height - PLOT.bottom;
    context.strokeStyle = colors.border;
    context.lineWidth = 1;
    context.strokeRect(PLOT.left, PLOT.top, this.plotWidth, this.plotHeight);
    context.fillStyle = colors.soft;
    context.font = '11px system-ui, "DejaVu Sans", sans-serif';
    context.textAlign = 'center';
    const perPixel = (this.to - this.from) / this.plotWidth;
    for (const {value, label} of ticksBetween(this.from, this.to, 80 * perPixel)) {
      context.fillText(label, this.px(value), bottom + 14);
    }
    const units = scene.units ? ` [${scene.units}]` : '';
    context.fillText(`length along the contour${units}`,
                     PLOT.left + 0.5 * this.plotWidth, bottom + 30);
    context.textAlign = 'right';
    for (const {value, label} of ticksBetween(-this.range, this.range,
                                              24 * 2 * this.range / this.plotHeight)) {
      context.fillText(label, PLOT.left - 6, this.py(value) + 4);
    }
  }
}
