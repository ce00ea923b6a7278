import assert from 'node:assert/strict';
import {before, describe, it} from 'node:test';

import {bandPaths} from '../../io/drawing/html/band.js';
import {View} from '../../io/drawing/html/geometry.js';
import {legendEntries} from '../../io/drawing/html/legend.js';
import {arrow, cross, ring, square} from '../../io/drawing/html/marks.js';
import {dotSize, visiblePoints} from '../../io/drawing/html/points.js';
import {Scene} from '../../io/drawing/html/scene.js';
import {arc, contourData, line, measuredData} from './pieces.js';

/** Stands for the path of a browser. */
class Path {
  calls = [];
  moveTo(...place) { this.calls.push(['moveTo', ...place]); }
  lineTo(...place) { this.calls.push(['lineTo', ...place]); }
}

/** Notes what is asked of a canvas. */
function canvasContext() {
  const calls = [];
  const note = (name) => (...values) => { calls.push([name, ...values]); };
  const names = ['arc', 'beginPath', 'closePath', 'fill', 'fillRect', 'lineTo', 'moveTo', 'stroke',
                 'strokeRect'];
  return {calls, ...Object.fromEntries(names.map((name) => [name, note(name)]))};
}

function view(scale) {
  return Object.assign(new View(), {width: 800, height: 600, x: 5, y: 0, scale});
}

const colors = {paper: 'white', text: 'black', start: 'green'};
const words = (scene) => legendEntries(scene).map(([, text]) => text);

describe('legendEntries', () => {
  it('lists the kinds that are there', () => {
    assert.deepEqual(words(new Scene(contourData([line([0, 0], [1, 0])]))),
                     ['line', 'joint', 'start', 'end']);
    assert.deepEqual(words(new Scene(contourData([arc([0, 0], 1, 0, 1)]))),
                     ['arc', 'joint', 'start', 'end']);
  });
  it('has no end for a closed contour', () => {
    const data = {...contourData([line([0, 0], [1, 0])]), isClosed: true};
    assert.deepEqual(words(new Scene(data)), ['line', 'joint', 'start and end']);
  });
  it('tells the magnification', () => {
    const scene = new Scene(measuredData([0.1, 0.1, 0.1], 0.2));
    scene.setMagnify(20);
    assert.ok(words(scene).includes('tolerance \u00d720'));
    scene.setMagnify(1);
    assert.ok(words(scene).includes('tolerance'));
  });
  it('tells about points outside only where there are some', () => {
    const last = (outside) => words(new Scene(measuredData([0, 0.3, 0], 0.2, outside))).at(-1);
    assert.equal(last([1]), 'outside tolerance');
    assert.equal(last([]), 'tolerance');
  });
  it('shows the order of points without a contour', () => {
    const data = {...contourData([]), points: {x: [0, 1], y: [0, 0], w: null}};
    assert.deepEqual(words(new Scene(data)), ['start', 'end', 'measured point', 'order']);
  });
});

describe('bandPaths', () => {
  before(() => { globalThis.Path2D = Path; });

  it('is one path as wide as both tolerances where all are the same', () => {
    const scene = new Scene(measuredData([0, 0, 0], 0.5));
    const paths = bandPaths(scene, view(10));
    assert.deepEqual([...paths.keys()], [10]);
    assert.deepEqual(paths.get(10).path.calls, [['moveTo', 350, 300], ['lineTo', 450, 300]]);
  });
  it('has a path for each width where tolerances differ', () => {
    const scene = new Scene({
      ...measuredData([0, 0, 0], [0.1, 0.4, 0.1]),
      band: {piece: [0, 0, 0], from: [0, 2, 8], to: [2, 8, 10], tolerance: [0.1, 0.4, 0.1]},
    });
    const paths = bandPaths(scene, view(10));
    assert.deepEqual([...paths.keys()], [2, 8]);
    assert.deepEqual(paths.get(8).path.calls, [['moveTo', 370, 300], ['lineTo', 430, 300]]);
    assert.equal(paths.get(2).path.calls.length, 4);
  });
  it('draws sections too short to be seen with the largest of their tolerances', () => {
    const scene = new Scene({
      ...measuredData([0, 0, 0], [0.1, 0.4, 0.1]),
      band: {piece: [0, 0, 0], from: [0, 0.01, 0.02], to: [0.01, 0.02, 10],
             tolerance: [0.1, 0.4, 0.1]},
    });
    assert.deepEqual([...bandPaths(scene, view(10)).keys()], [8]);
  });
});

describe('visiblePoints', () => {
  it('leaves out what hides behind an earlier point or lies outside', () => {
    const points = {x: [5, 5, 6, 500], y: [0, 0, 0, 0], w: null};
    const scene = new Scene({...contourData([]), points});
    assert.deepEqual(visiblePoints({scene, view: view(10)}), [0, 2]);
  });
});

describe('dotSize', () => {
  it('follows the distance of neighbours within its limits', () => {
    const sizeAt = (scale) => dotSize({scene: new Scene(measuredData([0, 0, 0], 1)),
                                       view: view(scale)}, [0, 1, 2]);
    assert.equal(sizeAt(0.1), 2.4);
    assert.equal(sizeAt(1), 0.65 * 5);
    assert.equal(sizeAt(100), 6);
  });
});

describe('marks', () => {
  it('cross has two strokes through the place', () => {
    const context = canvasContext();
    cross(context, [10, 20], 3);
    assert.deepEqual(context.calls, [['moveTo', 7, 17], ['lineTo', 13, 23],
                                     ['moveTo', 13, 17], ['lineTo', 7, 23]]);
  });
  it('ring is a circle about the place', () => {
    const context = canvasContext();
    ring(context, [10, 20], 5, 'red');
    assert.deepEqual(context.calls[1], ['arc', 10, 20, 5, 0, 2 * Math.PI]);
    assert.equal(context.strokeStyle, 'red');
  });
  it('square has its middle at the place', () => {
    const context = canvasContext();
    square(context, colors, [10, 20], 8);
    assert.deepEqual(context.calls, [['fillRect', 6, 16, 8, 8], ['strokeRect', 6, 16, 8, 8]]);
  });
  it('arrow points along its direction, whatever its length', () => {
    const context = canvasContext();
    arrow(context, colors, [10, 20], [0, 3], 6, false);
    assert.deepEqual(context.calls.slice(1, 4),
                     [['moveTo', 10, 26], ['lineTo', 7, 20], ['lineTo', 13, 20]]);
  });
  it('arrow is not drawn without a direction', () => {
    const context = canvasContext();
    arrow(context, colors, [10, 20], [0, 0], 6, true);
    arrow(context, colors, [10, 20], [NaN, 0], 6, true);
    assert.deepEqual(context.calls, []);
  });
});
