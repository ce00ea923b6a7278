import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {columnRanges} from '../../io/drawing/html/dots.js';
import {View} from '../../io/drawing/html/geometry.js';
import {pointRanges} from '../../io/drawing/html/points.js';
import {FEW_POINTS, Scene} from '../../io/drawing/html/scene.js';
import {rangesBy, Remembered} from '../../io/drawing/html/thinning.js';
import {line} from './pieces.js';
import {randomFrom} from './random.js';

/** Points along a segment of 1,000, each with a random deviation. */
function scan(count) {
  const random = randomFrom(7);
  const x = Array.from({length: count}, (_, i) => 1000 * i / (count - 1));
  const y = x.map(() => 2 * random() - 1);
  return new Scene({points: {x, y, w: 1}, pieces: [line([0, 0], [1000, 0])],
                    deviations: {signed: y, piece: x.map(() => 0), outside: []},
                    magnify: 1, worst: 0, isClosed: false});
}

function drawingOf(scene, scale, at = 500) {
  return {scene, view: Object.assign(new View(), {width: 1000, height: 400, x: at, y: 0, scale})};
}

/** A diagram of 1,000 pixels across. */
function diagramOf(scene, from = 0, to = 1000) {
  return {scene, values: scene.deviations.signed, from, to,
          px: (along) => 1000 * (along - from) / (to - from)};
}

describe('rangesBy', () => {
  it('finds the lowest and the highest of each key', () => {
    const keys = [5, 5, 9, 5, 9, null], values = [1, -2, 3, 4, 2, 99];
    assert.deepEqual(rangesBy(6, (i) => keys[i], (i) => values[i]),
                     {lowest: [1, 4], highest: [3, 2]});
  });
  it('takes the first of several alike', () => {
    assert.deepEqual(rangesBy(3, () => 0, () => 7), {lowest: [0], highest: [0]});
  });
  it('finds nothing in nothing', () => {
    assert.deepEqual(rangesBy(0, () => 0, () => 0), {lowest: [], highest: []});
  });
});

describe('Remembered', () => {
  it('makes again only for another key', () => {
    const kept = new Remembered();
    let made = 0;
    const make = () => ++made;
    assert.deepEqual(['a', 'a', 'b', 'a'].map((key) => kept.get(key, make)), [1, 1, 2, 3]);
  });
});

describe('pointRanges', () => {
  it('leaves few points to be drawn one by one', () => {
    assert.deepEqual(pointRanges(drawingOf(scan(FEW_POINTS), 1)).lowest, []);
  });
  it('has no more marks than pixels along the contour, and loses no extreme', () => {
    const scene = scan(100_000);
    const {lowest, highest} = pointRanges(drawingOf(scene, 1));
    assert.ok(lowest.length > 990 && lowest.length <= 1001, `${lowest.length}`);
    const y = scene.points.y;
    for (let i = 0; i < y.length; ++i) {
      const pixel = Math.floor(scene.points.x[i]);
      assert.ok(y[lowest[pixel]] <= y[i] && y[highest[pixel]] >= y[i], `point ${i}`);
    }
  });
  it('shows all points again where the view holds few', () => {
    assert.deepEqual(pointRanges(drawingOf(scan(100_000), 100)).lowest, []);
  });
  it('looks only at what is on the canvas', () => {
    const scene = scan(100_000);
    for (const i of pointRanges(drawingOf(scene, 10)).lowest) {
      assert.ok(scene.points.x[i] >= 450 && scene.points.x[i] <= 550);
    }
  });
  it('needs a contour that was measured against', () => {
    const x = Array.from({length: 9000}, (_, i) => i);
    const points = {x, y: x.map(() => 0), w: null};
    const scene = new Scene({points, pieces: [], deviations: null, isClosed: false});
    assert.deepEqual(pointRanges(drawingOf(scene, 1)).lowest, []);
  });
});

describe('columnRanges', () => {
  it('has one range in each column of pixels, and loses no extreme', () => {
    const scene = scan(50_000);
    const {lowest, highest} = columnRanges(diagramOf(scene));
    assert.ok(lowest.length >= 1000 && lowest.length <= 1001, `${lowest.length}`);
    const most = Math.max(...scene.points.y), least = Math.min(...scene.points.y);
    assert.ok(highest.some((i) => scene.points.y[i] === most));
    assert.ok(lowest.some((i) => scene.points.y[i] === least));
  });
  it('leaves few points in view to be drawn one by one', () => {
    assert.deepEqual(columnRanges(diagramOf(scan(50_000), 100, 170)).lowest, []);
  });
});
