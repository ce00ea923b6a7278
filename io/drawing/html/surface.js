// A canvas as sharp as the screen, and the gestures that every drawing understands.

import {readColors, isPrinting} from './numbers.js';

/** What is between the margins of A4 across, in pixels. */
export const PAPER_WIDTH = 1032;

export class Surface {
  /** @param paper width and height on paper in pixels, as the style sheet has them */
  constructor(canvas, paper, paint) {
    this.canvas = canvas;
    this.paper = paper;
    this.paint = paint;
    this.isScheduled = false;
    this.resolution = 0;
    // At once: until the next frame the old picture would be seen stretched to the new size.
    new ResizeObserver(() => this.draw()).observe(canvas);
  }

  schedule() {
    if (this.isScheduled) return;
    this.isScheduled = true;
    requestAnimationFrame(() => {
      this.isScheduled = false;
      this.draw();
    });
  }

  /** Draws at once; on paper in its size and with more pixels. */
  draw() {
    const canvas = this.canvas;
    this.width = isPrinting() ? this.paper[0] : canvas.clientWidth;
    this.height = isPrinting() ? this.paper[1] : canvas.clientHeight;
    const resolution = isPrinting() ? 3 : devicePixelRatio || 1;
    const width = Math.max(1, Math.round(this.width * resolution));
    const height = Math.max(1, Math.round(this.height * resolution));
    if (canvas.width !== width || canvas.height !== height) {
      canvas.width = width;
      canvas.height = height;
    }
    const context = canvas.getContext('2d');
    context.setTransform(width / this.width, 0, 0, height / this.height, 0, 0);
    this.paint(context, this.width, this.height, readColors());
  }
}

/**
 * Dragging, wheel, pinching, double click and keys of a canvas.
 * @param actions pan(dx, dy), zoom(px, py, factor), reset(), hover(px, py), leave(), tap(px, py),
 *     step(by)
 */
export function listenToGestures(canvas, actions) {
  const pointers = new Map();
  let moved = 0;

  const place = (event) => {
    const box = canvas.getBoundingClientRect();
    return [event.clientX - box.left - canvas.clientLeft,
            event.clientY - box.top - canvas.clientTop];
  };
  const spread = () => {
    const [a, b] = [...pointers.values()];
    return {x: 0.5 * (a[0] + b[0]), y: 0.5 * (a[1] + b[1]),
            size: Math.max(1, Math.hypot(a[0] - b[0], a[1] - b[1]))};
  };

  canvas.addEventListener('pointerdown', (event) => {
    canvas.setPointerCapture(event.pointerId);
    pointers.set(event.pointerId, place(event));
    moved = 0;
  });
  canvas.addEventListener('pointermove', (event) => {
    const at = place(event);
    if (!pointers.has(event.pointerId)) {
      actions.hover(...at);
      return;
    }
    const before = pointers.get(event.pointerId);
    const pinchBefore = pointers.size === 2 ? spread() : null;
    pointers.set(event.pointerId, at);
    moved += Math.hypot(at[0] - before[0], at[1] - before[1]);
    if (pinchBefore) {
      const pinch = spread();
      actions.pan(pinch.x - pinchBefore.x, pinch.y - pinchBefore.y);
      actions.zoom(pinch.x, pinch.y, pinch.size / pinchBefore.size);
    } else if (moved > 3) {
      canvas.classList.add('dragging');
      actions.pan(at[0] - before[0], at[1] - before[1]);
    }
  });
  const release = (event) => {
    if (!pointers.delete(event.pointerId)) return;
    canvas.classList.remove('dragging');
    if (event.type === 'pointerup' && moved <= 3) actions.tap(...place(event));
  };
  canvas.addEventListener('pointerup', release);
  canvas.addEventListener('pointercancel', release);
  canvas.addEventListener('pointerleave', () => actions.leave());
  canvas.addEventListener('wheel', (event) => {
    event.preventDefault();
    const lines = event.deltaMode === WheelEvent.DOM_DELTA_PIXEL ? 1 : 33;
    actions.zoom(...place(event), Math.exp(-0.0018 * lines * event.deltaY));
    actions.hover(...place(event));
  }, {passive: false});
  canvas.addEventListener('dblclick', () => actions.reset());
  listenToKeys(canvas, actions);
}

function listenToKeys(canvas, actions) {
  const middle = () => [0.5 * canvas.clientWidth, 0.5 * canvas.clientHeight];
  const keys = {
    '+': () => actions.zoom(...middle(), 1.4),
    '=': () => actions.zoom(...middle(), 1.4),
    '-': () => actions.zoom(...middle(), 1 / 1.4),
    '0': () => actions.reset(),
    Home: () => actions.reset(),
    ArrowLeft: () => actions.pan(60, 0),
    ArrowRight: () => actions.pan(-60, 0),
    ArrowUp: () => actions.pan(0, 60),
    ArrowDown: () => actions.pan(0, -60),
    n: () => actions.step(1),
    p: () => actions.step(-1),
    Escape: () => actions.leave(),
  };
  canvas.addEventListener('keydown', (event) => {
    if (event.ctrlKey || event.metaKey || event.altKey || !keys[event.key]) return;
    event.preventDefault();
    keys[event.key]();
  });
}
