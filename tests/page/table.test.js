import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {columnsOf, sweepText, worstOf} from '../../io/drawing/html/columns.js';
import {barsOf, histogramMarkup} from '../../io/drawing/html/histogram.js';
import {decimalsFor, decimalsOfRelatives, fixed, relativeText} from
  '../../io/drawing/html/numbers.js';
import {Scene} from '../../io/drawing/html/scene.js';
import {arc, contourData, line, measuredData} from './pieces.js';

const textOf = (scene, head, piece) =>
  columnsOf(scene).find((column) => column.head === head).text(scene.pieces[piece]);

describe('relativeText', () => {
  it('never reads as 1 beside it', () => {
    assert.equal(relativeText(0.99996), '0.99996');
    assert.equal(relativeText(1.0000004), '1.0000004');
    assert.equal(relativeText(1), '1');
    assert.equal(relativeText(0.12345), '0.1235');
  });
});

describe('decimalsOfRelatives', () => {
  it('is four, or as many as keep every value from reading as 1', () => {
    assert.equal(decimalsOfRelatives([0.5, 1, 0.9999]), 4);
    assert.equal(decimalsOfRelatives([0.5, 0.99996]), 5);
    assert.equal(decimalsOfRelatives([1 - 2 ** -53]), 16);
    assert.equal(decimalsOfRelatives([1 + 2 ** -52]), 16);
    assert.equal(decimalsOfRelatives([]), 4);
  });
});

describe('fixed', () => {
  it('has as many digits behind the point for every value, and no minus zero', () => {
    assert.equal(fixed(1.5, 3), '1.500');
    assert.equal(fixed(-0.0001, 2), '0.00');
    assert.equal(fixed(2e9, 3), '2000000000');
  });
  it('tells a hundredth of the tolerance', () => {
    assert.equal(decimalsFor(0.02), 4);
    assert.equal(decimalsFor(0.3), 3);
    assert.equal(decimalsFor(500), 0);
    assert.equal(decimalsFor(0), 9);
  });
});

describe('columnsOf', () => {
  it('aligns the lengths of a measured contour by its tolerance', () => {
    const scene = new Scene(measuredData([0.1, -0.15, 0.1], 0.2));
    assert.equal(textOf(scene, 'length', 0), '10.000');
    assert.equal(textOf(scene, 'of tolerance', 0), '0.7500');
    assert.equal(worstOf(scene, scene.pieces[0]), 0.15 / 0.2);
  });
  it('shows the measured beside the fitted', () => {
    const data = measuredData([0, 0, 0], 0.2);
    data.pieces = [{...arc([0, 0], 280, 1, 0.1), turn: Math.PI / 2,
                    measured: {radius: 300, radiusDeviation: 0.123, formError: 0.01,
                               standardDeviation: null}}];
    const scene = new Scene(data);
    assert.equal(textOf(scene, 'fitted radius', 0), '280.000');
    assert.equal(textOf(scene, 'measured radius', 0), '300.000');
    assert.equal(textOf(scene, '\u00b1', 0), '0.1230', 'as many digits as the form error');
    assert.equal(textOf(scene, 'form error', 0), '0.0100');
    assert.equal(textOf(scene, 'std. deviation', 0), '', 'not known');
    assert.equal(textOf(scene, 'turn to next', 0), '90.000\u00b0');
    assert.equal(textOf(scene, 'measured direction', 0), '', 'an arc has none');
  });
  it('has nothing about deviations where nothing was measured', () => {
    const heads = columnsOf(new Scene(contourData([line([0, 0], [1, 0])]))).map((c) => c.head);
    assert.ok(heads.includes('centre x'));
    assert.ok(!heads.includes('measured radius') && !heads.includes('points'));
  });
  it('shows the direction of an arc', () => {
    assert.equal(sweepText(arc([0, 0], 1, 0, Math.PI, false)), '180.000\u00b0 \u21bb');
  });
});

describe('The histogram', () => {
  const histogram = {kind: 'relative', low: -1, width: 0.5, counts: [1, 4, 0, 2],
                     below: 2, above: 0};
  it('has bars from below to above, the largest as high as can be', () => {
    assert.deepEqual(barsOf(histogram), [0.5, 0.25, 1, 0, 0.5, 0]);
    assert.deepEqual(barsOf({...histogram, counts: [0], below: 0, above: 0}), [0, 0, 0]);
  });
  it('draws those outside in their colour', () => {
    const markup = histogramMarkup(histogram, 'deviation', 200);
    assert.equal(markup.match(/<rect/g).length, 6);
    assert.equal(markup.match(/--outside/g).length, 2);
    assert.equal(histogramMarkup({...histogram, kind: 'absolute'}, 'deviation', 200)
      .includes('--outside'), false);
  });
});

describe('isTall', () => {
  it('is a part much higher than wide', () => {
    assert.equal(new Scene(contourData([line([0, 0], [1, 10])])).isTall, true);
    assert.equal(new Scene(contourData([line([0, 0], [10, 10])])).isTall, false);
  });
});
