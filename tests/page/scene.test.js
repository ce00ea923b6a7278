import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {Occupancy, Scene} from '../../io/drawing/html/scene.js';
import {arc, contourData, line, measuredData} from './pieces.js';

describe('Occupancy', () => {
  it('gives each place once', () => {
    const free = new Occupancy(100, 50, 2);
    assert.equal(free.take(10, 10), true);
    assert.equal(free.take(11.9, 10), false);
    assert.equal(free.take(12, 10), true);
  });
  it('gives no place outside the canvas', () => {
    const free = new Occupancy(100, 50, 2);
    for (const [x, y] of [[-1, 5], [5, -1], [500, 5], [5, 500], [NaN, 5]]) {
      assert.equal(free.take(x, y), false, `${x} ${y}`);
    }
  });
});

describe('Scene', () => {
  it('adds up the lengths of the pieces', () => {
    const scene = new Scene(contourData([line([0, 0], [3, 4]), arc([3, 5], 1, -Math.PI / 2, 2)]));
    assert.deepEqual(scene.starts, [0, 5, 7]);
    assert.equal(scene.length, 7);
    assert.equal(scene.isMeasured, false);
  });
  it('takes from the data what is outside its tolerance', () => {
    const scene = new Scene(measuredData([0.1, -0.2, 0.3], 0.2, [2]));
    assert.deepEqual([0, 1, 2].map((i) => scene.isOutside(i)), [false, false, true]);
    assert.equal(scene.relative(2), 0.3 / 0.2);
  });
  it('finds the foot of each point on its piece', () => {
    const data = measuredData([0.1, -0.2, 0.3], 0.2);
    data.pieces = [line([-5, 0], [5, 0]), line([5, 0], [10, 0])];
    data.deviations.piece = [0, 0, 1];
    const scene = new Scene(data);
    assert.deepEqual([...scene.alongs], [5, 10, 15]);
    assert.deepEqual([[...scene.footX], [...scene.footY]], [[0, 5, 10], [0, 0, 0]]);
  });
  it('knows tolerances of their own from one for all', () => {
    const one = new Scene(measuredData([0, 0, 0], 0.2));
    const own = new Scene(measuredData([0, 0, 0], [0.1, 0.4, 0.2]));
    assert.deepEqual([one.isToleranceUniform, one.largestTolerance, one.tolerance(1)],
                     [true, 0.2, 0.2]);
    assert.deepEqual([own.isToleranceUniform, own.largestTolerance, own.tolerance(1)],
                     [false, 0.4, 0.4]);
  });
  it('does without tolerances', () => {
    const scene = new Scene(measuredData([0.1, 0.2, 0.3], null));
    assert.deepEqual([scene.hasTolerances, scene.largestTolerance, scene.relative(0)],
                     [false, 0, null]);
    assert.equal(scene.isOutside(2), false);
  });
  it('counts the points of a piece and finds its worst by share of the tolerance', () => {
    const [piece] = new Scene(measuredData([0.1, 0.3, -0.2], [0.1, 1, 0.4])).pieces;
    assert.deepEqual([piece.points, piece.worst], [3, 0]);
  });
  it('moves the points away from their feet, and back', () => {
    const scene = new Scene(measuredData([0.1, -0.2, 0.3], 0.2));
    scene.setMagnify(10);
    assert.deepEqual([...scene.x], [0, 5, 10]);
    [1, -2, 3].forEach((y, i) => assert.ok(Math.abs(scene.y[i] - y) < 1e-12));
    assert.equal(scene.grid.nearest(5, -2, 0.1), 1);
    scene.setMagnify(1);
    assert.deepEqual([...scene.y], [0.1, -0.2, 0.3]);
  });
  it('has nothing to magnify without points', () => {
    const scene = new Scene(contourData([line([0, 0], [1, 0])]));
    scene.setMagnify(50);
    assert.equal(scene.times, 1);
  });
  it('offers round magnifications up to ten times its own, in order, its own among them', () => {
    const data = {...measuredData([0, 0, 0], 1), magnify: 7};
    assert.deepEqual(new Scene(data).magnifications(), [1, 2, 5, 7, 10, 20, 50]);
  });
  it('has a box around points and pieces', () => {
    const scene = new Scene(measuredData([0.1, -0.2, 0.3], 0.2));
    assert.deepEqual(scene.box(), [0, -0.2, 10, 0.3]);
  });
  it('has a box around the pieces alone', () => {
    assert.deepEqual(new Scene(contourData([line([1, 2], [3, -4])])).box(), [1, -4, 3, 2]);
  });
  it('does not let a far magnified point shrink the rest', () => {
    const scene = new Scene(measuredData([0.1, -0.2, 0.3], 0.2));
    scene.setMagnify(1e6);
    const [, yMin, , yMax] = scene.box();
    assert.ok(yMin >= -5.2 && yMax <= 5.3);
  });
  it('finds the piece under the cursor', () => {
    const scene = new Scene(contourData([line([0, 0], [10, 0]), line([10, 0], [10, 10])]));
    assert.equal(scene.pieceNear(9.9, 5, 0.5), 1);
    assert.equal(scene.pieceNear(5, 0.2, 0.5), 0);
    assert.equal(scene.pieceNear(5, 5, 0.5), -1);
  });
});
