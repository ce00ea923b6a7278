import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {niceStep, short, ticksBetween} from '../../io/drawing/html/numbers.js';
import {randomFrom} from './random.js';

describe('short', () => {
  it('keeps six significant digits and no trailing zeros', () => {
    assert.equal(short(1.23456789), '1.23457');
    assert.equal(short(0.5), '0.5');
    assert.equal(short(1200), '1200');
    assert.equal(short(-0.000123456789), '-0.000123457');
  });
  it('keeps as many digits as it is asked for', () => assert.equal(short(Math.PI, 3), '3.14'));
  it('gives nothing for what is not there', () => {
    assert.equal(short(null), '');
    assert.equal(short(undefined), '');
  });
  it('writes zero without a sign', () => assert.equal(short(-0), '0'));
});

describe('niceStep', () => {
  it('gives 1, 2 or 5 times a power of ten', () => {
    const cases = [[1, 1], [1.1, 2], [2, 2], [2.1, 5], [5, 5], [5.1, 10], [9.9, 10], [0.03, 0.05],
                   [700, 1000]];
    for (const [least, step] of cases) assert.ok(Math.abs(niceStep(least) - step) < 1e-12 * step);
  });
  it('is not below what it is given and less than two and a half times as large', () => {
    const random = randomFrom(1);
    for (let i = 0; i < 2000; ++i) {
      const least = 10 ** (20 * random() - 10);
      const step = niceStep(least);
      assert.ok(step >= least * (1 - 1e-11) && step <= 2.5 * least * (1 + 1e-11), `${least}`);
    }
  });
});

describe('ticksBetween', () => {
  it('counts from end to end', () => {
    assert.deepEqual(ticksBetween(0, 1, 0.25).map(({label}) => label), ['0.0', '0.5', '1.0']);
    assert.deepEqual(ticksBetween(-3, 3, 2).map(({value}) => value), [-2, 0, 2]);
  });
  it('writes zero without a sign', () => {
    assert.deepEqual(ticksBetween(-0.2, 0.2, 0.2).map(({label}) => label), ['-0.2', '0.0', '0.2']);
  });
  it('writes very large and very small numbers with few digits', () => {
    assert.deepEqual(ticksBetween(1e8, 2e8, 1e8).map(({label}) => label),
                     ['100000000', '200000000']);
    assert.deepEqual(ticksBetween(0, 1e-9, 1e-9).map(({label}) => label), ['0', '1e-9']);
  });
  it('gives no tick where none fits', () => assert.deepEqual(ticksBetween(0.1, 0.2, 1), []));
  it('stays within the range, in order and no closer than asked', () => {
    const random = randomFrom(2);
    for (let i = 0; i < 500; ++i) {
      const low = 2000 * random() - 1000;
      const high = low + 10 ** (6 * random() - 3);
      const least = (high - low) * (0.02 + random());
      const values = ticksBetween(low, high, least).map(({value}) => value);
      for (const value of values) assert.ok(value >= low && value <= high);
      for (let k = 1; k < values.length; ++k) {
        assert.ok(values[k] - values[k - 1] >= least * (1 - 1e-6), `${low} ${high} ${least}`);
      }
    }
  });
});
