// The grid and the numbers along its edges, on a canvas that notes what is drawn.

import assert from 'node:assert/strict';
import {describe, it} from 'node:test';

import {gridTicks, paintAxisLabels, paintGrid} from '../../io/drawing/html/axes.js';
import {View} from '../../io/drawing/html/geometry.js';

function viewOfTen() {
  const view = new View();
  [view.width, view.height] = [400, 400];
  view.fit([0, 0, 10, 10], 0);
  return view;
}

describe('gridTicks', () => {
  it('keeps lines as far apart as their numbers need', () => {
    const {columns, rows} = gridTicks(viewOfTen());
    assert.deepEqual(columns.map(({value}) => value), [0, 5, 10]);
    assert.deepEqual(rows.map(({value}) => value), [0, 2, 4, 6, 8, 10]);
  });
});

describe('paintGrid', () => {
  it('draws a line across the canvas for each tick', () => {
    const lines = [];
    const context = {
      beginPath() {}, stroke() {},
      moveTo(x, y) { lines.push([x, y]); },
      lineTo(x, y) { lines.at(-1).push(x, y); },
    };
    paintGrid(context, viewOfTen(), {columns: [{value: 5}], rows: [{value: 10}]}, 'grey');
    assert.deepEqual(lines, [[200, 0, 200, 400], [0, 0, 400, 0]]);
    assert.equal(context.strokeStyle, 'grey');
  });
});

describe('paintAxisLabels', () => {
  it('names both axes with their units, and leaves their corners free', () => {
    const texts = [];
    const context = {strokeText() {}, fillText(text) { texts.push(text); }};
    const view = viewOfTen();
    const colors = {paper: 'white', soft: 'grey'};
    paintAxisLabels(context, view, gridTicks(view), {colors, units: 'mm'});
    assert.ok(texts.includes('x [mm]') && texts.includes('y [mm]'));
    assert.ok(!texts.includes('10'));
    assert.ok(texts.includes('5'));
  });
});
