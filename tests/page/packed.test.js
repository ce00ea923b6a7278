import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {unpacked} from '../../io/drawing/html/packed.js';
import {Scene} from '../../io/drawing/html/scene.js';
import {packed} from './packed.js';
import {measuredData} from './pieces.js';
import {randomFrom} from './random.js';

describe('unpacked', () => {
  it('reads a column written by hand', () => {
    // 150 is 300 without its sign, that is 0xAC 0x02; -1 is 1; two zeros are 0 and one more.
    const bytes = Buffer.from([0xac, 0x02, 0x01, 0x00, 0x01]).toString('base64');
    assert.deepEqual([...unpacked({decimals: 0, order: 0, count: 4, bytes})], [150, -1, 0, 0]);
    assert.deepEqual([...unpacked({decimals: 1, order: 1, count: 4, bytes})],
                     [15, 14.9, 14.9, 14.9]);
  });
  it('gives back what is not packed', () => {
    const numbers = [1, 2];
    assert.equal(unpacked(numbers), numbers);
    assert.equal(unpacked(0.2), 0.2);
    assert.equal(unpacked(null), null);
  });
  it('takes an empty column', () => assert.equal(unpacked(packed([])).length, 0));
  it('gives the very number that has so many decimals', () => {
    const random = randomFrom(3);
    const texts = Array.from({length: 2000}, () => (2000 * random() - 1000).toFixed(7));
    const multiples = texts.map((text) => Number(text.replace('.', '')));
    for (const order of [0, 1, 2]) {
      assert.deepEqual([...unpacked(packed(multiples, {decimals: 7, order}))],
                       texts.map(Number).map((value) => value + 0));
    }
  });
  it('reads multiples up to 2^50 with their signs', () => {
    const large = [2 ** 50 - 1, -(2 ** 50 - 1), 2 ** 50 - 2];
    for (const order of [0, 1, 2]) {
      assert.deepEqual([...unpacked(packed(large, {order}))], large, `order ${order}`);
    }
  });
  it('multiplies by tens where decimals are negative', () => {
    assert.deepEqual([...unpacked(packed([3, -4], {decimals: -3}))], [3000, -4000]);
  });
});

describe('A scene of packed columns', () => {
  function data() {
    const made = measuredData([0.1, -0.2, 0.3], [0.2, 0.2, 0.4], [1]);
    made.points = {x: packed([0, 500, 1000], {decimals: 2, order: 2}),
                   y: packed([10, -20, 30], {decimals: 2, order: 1}),
                   w: packed([20, 20, 40], {decimals: 2})};
    made.deviations.signed = packed([10, -20, 30], {decimals: 2});
    made.deviations.piece = packed([0, 0, 0]);
    return made;
  }
  it('is the scene of the numbers themselves', () => {
    const scene = new Scene(data());
    assert.deepEqual([[...scene.x], [...scene.y]], [[0, 5, 10], [0.1, -0.2, 0.3]]);
    assert.deepEqual([scene.largestTolerance, scene.tolerance(0)], [0.4, 0.2]);
    assert.deepEqual([...scene.alongs], [0, 5, 10]);
    assert.deepEqual([0, 1, 2].map((i) => scene.isOutside(i)), [false, true, false]);
    assert.equal(scene.step, 0.01);
  });
  it('keeps the very numbers of some points', () => {
    const made = data();
    made.deviations.exact = {index: [1], signed: [-0.2000004], w: [0.2000001]};
    const scene = new Scene(made);
    assert.deepEqual([scene.deviation(1), scene.tolerance(1)], [-0.2000004, 0.2000001]);
    assert.deepEqual([scene.deviation(0), scene.tolerance(0)], [0.1, 0.2]);
  });
  it('knows that exact numbers have no step', () => {
    assert.equal(new Scene(measuredData([0, 0, 0], 0.2)).step, 0);
  });
});
