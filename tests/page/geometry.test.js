import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {boxOf, distanceTo, footOn, include, placeOn, PointGrid, Tracer, View}
  from '../../io/drawing/html/geometry.js';
import {arc, line} from './pieces.js';
import {randomFrom} from './random.js';

const quarter = 0.5 * Math.PI;

function assertNear(found, expected, tolerance = 1e-12) {
  assert.equal(found.length, expected.length);
  found.forEach((value, i) => assert.ok(Math.abs(value - expected[i]) <= tolerance,
                                        `${found} is not ${expected}`));
}

describe('placeOn', () => {
  it('goes along a line', () => {
    const piece = line([1, 2], [4, 6]);
    assertNear(placeOn(piece, 0), [1, 2]);
    assertNear(placeOn(piece, 2.5), [2.5, 4]);
    assertNear(placeOn(piece, 5), [4, 6]);
  });
  it('goes along an arc in its own sense', () => {
    assertNear(placeOn(arc([0, 0], 2, 0, quarter), quarter), [Math.SQRT2, Math.SQRT2]);
    assertNear(placeOn(arc([0, 0], 2, 0, quarter, false), quarter), [Math.SQRT2, -Math.SQRT2]);
  });
  it('stays at the start of a piece without length', () => {
    assertNear(placeOn(line([3, 3], [3, 3]), 0), [3, 3]);
  });
});

describe('include', () => {
  it('widens the box, and leaves out what is not finite', () => {
    const box = [0, 0, 1, 1];
    include(box, -1, 5);
    include(box, NaN, 9);
    include(box, 9, Infinity);
    assert.deepEqual(box, [-1, 0, 1, 5]);
  });
});

describe('boxOf', () => {
  it('holds a line exactly', () => assert.deepEqual(boxOf(line([3, 1], [-2, 4])), [-2, 1, 3, 4]));
  it('holds the top of an arc, not only its ends', () => {
    assertNear(boxOf(arc([0, 0], 1, 0, 2 * quarter)), [-1, 0, 1, 1], 1e-2);
  });
});

describe('View', () => {
  function view() {
    const made = new View();
    Object.assign(made, {width: 800, height: 600});
    made.fit([-10, -5, 30, 15], 50);
    return made;
  }
  it('shows the whole box inside the margin, its middle in the middle', () => {
    const made = view();
    assert.equal(made.scale, 700 / 40);
    assertNear([made.px(10), made.py(5)], [400, 300]);
    assertNear([made.px(-10), made.px(30)], [50, 750]);
  });
  it('has y up', () => assert.ok(view().py(6) < view().py(5)));
  it('goes from the plane to pixels and back', () => {
    const made = view();
    assertNear([made.planeX(made.px(3.25)), made.planeY(made.py(-7.5))], [3.25, -7.5]);
  });
  it('zooms about the place under the pixel', () => {
    const made = view();
    const before = [made.planeX(123), made.planeY(456)];
    made.zoomAt(123, 456, 3);
    assertNear([made.planeX(123), made.planeY(456)], before);
    assert.equal(made.scale, 3 * 700 / 40);
  });
  it('moves by pixels', () => {
    const made = view();
    const before = [made.px(0), made.py(0)];
    made.pan(10, -20);
    assertNear([made.px(0), made.py(0)], [before[0] + 10, before[1] - 20]);
  });
  it('shows a box without size at the scale of one', () => {
    const made = view();
    made.fit([2, 3, 2, 3], 50);
    assert.deepEqual([made.scale, made.x, made.y], [1, 2, 3]);
  });
});

/** Keeps what is drawn as lists of places, one for each stroke. */
class Recorder {
  strokes = [];
  moveTo(x, y) { this.strokes.push([[x, y]]); }
  lineTo(x, y) { this.strokes.at(-1).push([x, y]); }
}

describe('Tracer', () => {
  function trace(piece, center = [0, 0], scale = 10) {
    const view = Object.assign(new View(), {width: 400, height: 400, scale,
                                            x: center[0], y: center[1]});
    const path = new Recorder();
    const tracer = new Tracer(view, path, 20);
    tracer.trace(piece);
    return {view, tracer, strokes: path.strokes};
  }
  it('draws a line that is in view from end to end', () => {
    const {strokes} = trace(line([-5, 0], [5, 5]));
    assert.deepEqual(strokes, [[[150, 200], [250, 150]]]);
  });
  it('cuts a line where it leaves the canvas', () => {
    const {strokes, tracer} = trace(line([-1000, 0], [1000, 0]));
    assertNear(strokes[0].flat(), [-20, 200, 420, 200], 1e-9);
    assert.ok(Math.abs(tracer.skipped - (10000 - 220)) < 1e-6);
  });
  it('draws nothing of a piece that is away', () => {
    assert.deepEqual(trace(line([100, 100], [200, 100])).strokes, []);
    assert.deepEqual(trace(arc([100, 100], 5, 0, 3)).strokes, []);
  });
  it('draws an arc in one stroke that stays near it', () => {
    const piece = arc([1, 2], 12, 0.3, 4.5);
    const {strokes, view} = trace(piece);
    assert.equal(strokes.length, 1);
    assertNear(strokes[0][0], [view.px(piece.start[0]), view.py(piece.start[1])], 1e-9);
    assertNear(strokes[0].at(-1), [view.px(piece.end[0]), view.py(piece.end[1])], 1e-9);
    const [cx, cy] = [view.px(1), view.py(2)];
    for (let k = 1; k < strokes[0].length; ++k) {
      const [ax, ay] = strokes[0][k - 1], [bx, by] = strokes[0][k];
      for (const part of [0, 0.5]) {
        const x = ax + part * (bx - ax), y = ay + part * (by - ay);
        assert.ok(Math.abs(Math.hypot(x - cx, y - cy) - 120) < 0.1);
      }
    }
  });
  it('finishes however far the zoom goes', () => {
    const piece = arc([0, 0], 1, 0, 2 * quarter);
    const {strokes} = trace(piece, [0, 1], 1e9);
    assert.ok(strokes.length >= 1 && strokes.flat().length < 200);
  });
});

describe('PointGrid', () => {
  it('finds the same point as looking at all of them', () => {
    const random = randomFrom(3);
    for (const count of [1, 2, 17, 400]) {
      const x = Array.from({length: count}, () => Math.round(40 * random()) / 4);
      const y = Array.from({length: count}, () => Math.round(40 * random()) / 4);
      const grid = new PointGrid(x, y);
      for (let query = 0; query < 200; ++query) {
        const [px, py, reach] = [14 * random() - 2, 14 * random() - 2, 4 * random()];
        let expected = -1, least = reach * reach;
        for (let i = 0; i < count; ++i) {
          const distance = (x[i] - px) ** 2 + (y[i] - py) ** 2;
          if (distance < least || (distance === least && expected < 0)) {
            [expected, least] = [i, distance];
          }
        }
        assert.equal(grid.nearest(px, py, reach), expected, `${count} ${px} ${py} ${reach}`);
      }
    }
  });
  it('finds nothing among no points', () => {
    assert.equal(new PointGrid([], []).nearest(0, 0, 10), -1);
  });
  it('gives the first of several at the same place', () => {
    assert.equal(new PointGrid([1, 1, 1], [2, 2, 2]).nearest(1, 2, 1), 0);
  });
});

describe('distanceTo', () => {
  it('is that to the foot on a line, or to the nearer end', () => {
    const piece = line([0, 0], [10, 0]);
    assert.equal(distanceTo(piece, 4, 3), 3);
    assert.equal(distanceTo(piece, 13, 4), 5);
    assert.equal(distanceTo(piece, -3, -4), 5);
  });
  it('is that to the circle within the sweep of an arc, or to the nearer end', () => {
    for (const ccw of [true, false]) {
      const piece = arc([0, 0], 5, ccw ? 0 : quarter, quarter, ccw);
      assert.ok(Math.abs(distanceTo(piece, 6, 6) - (Math.hypot(6, 6) - 5)) < 1e-12);
      assert.ok(Math.abs(distanceTo(piece, 5, -2) - 2) < 1e-12);
      assert.ok(Math.abs(distanceTo(piece, -2, 5) - 2) < 1e-12);
    }
  });
  it('is that to the place of a piece without length', () => {
    assert.equal(distanceTo(line([1, 1], [1, 1]), 4, 5), 5);
  });
  it('is no larger than the distance to any place of the piece', () => {
    const random = randomFrom(4);
    for (let i = 0; i < 300; ++i) {
      const piece = arc([random(), random()], 0.1 + random(), 6 * random(), 6 * random(),
                        random() < 0.5);
      const [x, y] = [4 * random() - 2, 4 * random() - 2];
      const distance = distanceTo(piece, x, y);
      let least = Infinity;
      for (let k = 0; k <= 400; ++k) {
        const [px, py] = placeOn(piece, piece.length * k / 400);
        least = Math.min(least, Math.hypot(px - x, py - y));
      }
      assert.ok(distance <= least + 1e-12 && distance >= least - 0.02, `${i}`);
    }
  });
});

describe('footOn', () => {
  it('is the length from the start to the nearest place, the ends included', () => {
    const piece = line([1, 1], [5, 1]);
    assert.deepEqual([footOn(piece, 3, 7), footOn(piece, -9, 2), footOn(piece, 8, 2)], [2, 0, 4]);
    const bow = arc([0, 0], 2, 0, quarter);
    assertNear([footOn(bow, 3, 3), footOn(bow, 2, -1), footOn(bow, -1, 2)],
               [quarter, 0, 2 * quarter]);
    assertNear([footOn(arc([0, 0], 2, 0, quarter, false), 1, -1)], [quarter]);
  });
  it('is the start of a piece without length', () => {
    assert.equal(footOn(line([3, 3], [3, 3]), 5, 5), 0);
  });
  it('is as near as any other place of the piece', () => {
    const random = randomFrom(11);
    for (let k = 0; k < 200; ++k) {
      const piece = k % 2 ? line([random(), random()], [random(), random()])
                          : arc([random(), random()], random() + 0.1, 6 * random(), 6 * random(),
                                k % 4 === 0);
      const [x, y] = [3 * random() - 1, 3 * random() - 1];
      const distance = distanceTo(piece, x, y);
      for (let i = 0; i <= 100; ++i) {
        const place = placeOn(piece, piece.length * i / 100);
        assert.ok(Math.hypot(x - place[0], y - place[1]) >= distance - 1e-12);
      }
    }
  });
});
