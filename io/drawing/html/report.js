// Puts the page together.

import {relativeText, short} from './numbers.js';
import {sweepText} from './columns.js';
import {Scene} from './scene.js';
import {listenToGestures} from './surface.js';
import {ContourDrawing} from './contour.js';
import {Diagram} from './diagram.js';
import {fillLegend} from './legend.js';
import {PieceTable, element} from './table.js';
import {fillHistogram} from './histogram.js';

const scene = new Scene(JSON.parse(document.getElementById('data').textContent));
const state = {hovered: -1, hoveredPiece: -1, chosen: -1};
const byId = (id) => document.getElementById(id);
const units = scene.units ? ` ${scene.units}` : '';

const contour = new ContourDrawing(byId('contour'), scene, state);
const diagram = scene.isMeasured ? new Diagram(byId('diagram'), scene, state) : null;
const table = scene.hasContour
    ? new PieceTable(scene, {hover: (i) => hoverPiece(i), choose: choosePiece}) : null;

function redraw() {
  contour.surface.schedule();
  diagram?.surface.schedule();
  table?.mark(state);
}

// Summary

function fillHead() {
  for (const [name, value] of scene.fields) {
    const entry = element('div');
    entry.append(element('dt', name), element('dd', value));
    byId('fields').append(entry);
  }
  if (scene.program) byId('program').textContent = `Made by ${scene.program}.`;
  if (scene.step > 0) {
    byId('rounding').textContent = `The numbers of so many points are rounded to ${scene.step}` +
        `${units}; the table of the pieces and the verdict come from the exact ones.`;
  }
}

function fillSummary() {
  byId('facts').textContent = scene.facts.join(', ');
  const verdict = byId('verdict');
  if (scene.verdict) {
    verdict.hidden = false;
    verdict.textContent = scene.verdict.text;
    verdict.className = scene.verdict.isGood ? 'good' : 'bad';
  }
  const entries = scene.count > 0 ? [['points', String(scene.count)]] : [];
  if (scene.hasContour) {
    const arcs = scene.pieces.filter((piece) => piece.kind === 'arc').length;
    entries.push(
        ['lines, arcs', `${scene.pieces.length - arcs}, ${arcs}`],
        ['length', short(scene.length) + units]);
  }
  if (scene.isMeasured) {
    const worst = scene.worst;
    entries.push(
        [`largest, at point ${worst}`, short(Math.abs(scene.deviation(worst)), 4) + units]);
    if (scene.hasTolerances) {
      entries.push(['of its tolerance', relativeText(Math.abs(scene.relative(worst)))],
                   ['outside', `${scene.summary.outside} of ${scene.count}`]);
    }
    entries.push(['root mean square', short(scene.summary.rootMeanSquare, 4) + units],
                 ['mean', short(scene.summary.mean, 3) + units]);
  }
  for (const [name, value] of entries) {
    const entry = element('div');
    entry.append(element('dt', name), element('dd', value));
    byId('summary').append(entry);
  }
}

// Hovering and choosing

function describePoint(i) {
  const rows = ['x', 'y'].map((axis) => [axis, short(scene.points[axis][i], 12) + units]);
  if (scene.tolerance(i) !== null) rows.push(['tolerance', short(scene.tolerance(i)) + units]);
  if (scene.hasContour) {
    const deviation = scene.deviation(i);
    const side = deviation > 0 ? 'left' : 'right';
    rows.push(['deviation', short(Math.abs(deviation), 5) + units + (deviation ? ` ${side}` : '')]);
    if (scene.hasTolerances) rows.push(['of tolerance', relativeText(Math.abs(scene.relative(i)))]);
    const number = scene.pieceOf(i) + 1;
    rows.push(['piece', `${number} (${scene.pieces[number - 1].kind})`]);
  }
  return rows;
}

function describePiece(index) {
  const piece = scene.pieces[index];
  const rows = [['length', short(piece.length) + units]];
  if (piece.kind === 'arc') {
    rows.push(['fitted radius', short(piece.radius) + units], ['sweep', sweepText(piece)]);
  }
  const {measured} = piece;
  if (measured?.radius) rows.push(['measured radius', short(measured.radius) + units]);
  if (measured) rows.push(['form error', short(measured.formError, 4) + units]);
  if (scene.isMeasured) rows.push(['points', String(piece.points)]);
  return rows;
}

/** The box with what is under the cursor, beside the place but inside the stage. */
function showTip(title, rows, [x, y]) {
  const tip = byId('tip');
  const list = element('table');
  for (const [name, value] of rows) {
    const row = element('tr');
    row.append(element('td', name), element('td', value));
    list.append(row);
  }
  tip.replaceChildren(element('b', title), list);
  tip.hidden = false;
  const stage = byId('contour-stage');
  const left = x + 18 + tip.offsetWidth > stage.clientWidth ? x - 18 - tip.offsetWidth : x + 18;
  const top = Math.min(Math.max(4, y + 14), stage.clientHeight - tip.offsetHeight - 4);
  tip.style.transform = `translate(${Math.max(4, left)}px, ${top}px)`;
}

function hideTip() { byId('tip').hidden = true; }

function hoverPoint(i) {
  state.hovered = i;
  state.hoveredPiece = scene.hasContour ? scene.pieceOf(i) : -1;
  showTip(`Point ${i}`, describePoint(i), contour.pixelOf(i));
  redraw();
}

function hoverPiece(index, at = null) {
  state.hovered = -1;
  state.hoveredPiece = index;
  if (index >= 0 && at) {
    showTip(`Piece ${index + 1}: ${scene.pieces[index].kind}`, describePiece(index), at);
  } else {
    hideTip();
  }
  redraw();
}

function choosePiece(index) {
  state.chosen = state.chosen === index ? -1 : index;
  if (state.chosen >= 0) {
    contour.showPiece(index);
    diagram?.showPiece(index);
  } else {
    showAll();
  }
  redraw();
}

function showAll() {
  contour.showAll();
  diagram?.showAll();
}

/** The point under the cursor, or else the piece. */
function hoverContour(x, y) {
  const point = contour.pointAt(x, y, 12);
  if (point >= 0) hoverPoint(point);
  else hoverPiece(contour.pieceAt(x, y, 7), [x, y]);
  table?.scrollTo(state.hoveredPiece);
}

function hoverDiagram(x, y) {
  const point = diagram.pointAt(x, y, 12);
  if (point >= 0) hoverPoint(point);
  else hoverPiece(diagram.pieceAt(x));
  table.scrollTo(state.hoveredPiece);
}

/** The point before or after, brought into view. */
function stepPoint(by) {
  if (scene.count === 0) return;
  const next = state.hovered < 0 ? 0 : Math.min(scene.count - 1, Math.max(0, state.hovered + by));
  const [x, y] = contour.pixelOf(next);
  const {width, height} = contour.view;
  const isInside = x >= 20 && y >= 20 && x <= width - 20 && y <= height - 20;
  if (!isInside) contour.pan(0.5 * width - x, 0.5 * height - y);
  hoverPoint(next);
}

listenToGestures(byId('contour'), {
  pan: (dx, dy) => { hideTip(); contour.pan(dx, dy); },
  zoom: (x, y, factor) => contour.zoom(x, y, factor),
  reset: showAll,
  hover: hoverContour,
  leave: () => hoverPiece(-1),
  tap: hoverContour,
  step: stepPoint,
});
if (diagram) {
  listenToGestures(byId('diagram'), {
    pan: (dx) => diagram.pan(dx),
    zoom: (x, y, factor) => diagram.zoom(x, y, factor),
    reset: () => diagram.showAll(),
    hover: hoverDiagram,
    leave: () => hoverPiece(-1),
    tap: hoverDiagram,
    step: stepPoint,
  });
}

// Controls

function zoomMiddle(factor) {
  contour.zoom(0.5 * contour.view.width, 0.5 * contour.view.height, factor);
}

byId('zoom-in').addEventListener('click', () => zoomMiddle(1.5));
byId('zoom-out').addEventListener('click', () => zoomMiddle(1 / 1.5));
byId('reset').addEventListener('click', showAll);
byId('back').addEventListener('click', showAll);
contour.onPainted = (isAnything) => { byId('empty').hidden = isAnything; };
byId('all-columns').addEventListener('change', (event) => {
  byId('main').classList.toggle('all', event.target.checked);
});

function setUpMagnify() {
  const steps = scene.magnifications();
  const slider = byId('magnify');
  slider.max = steps.length - 1;
  slider.value = steps.indexOf(scene.magnify);
  const apply = () => {
    const times = steps[Number(slider.value)];
    byId('magnify-value').textContent = `\u00d7${short(times)}`;
    scene.setMagnify(times);
    fillLegend(byId('legend'), scene);
    hideTip();
    contour.surface.schedule();
  };
  slider.addEventListener('input', apply);
  apply();
}

function setUpDiagram() {
  const title = () => {
    byId('diagram-title').textContent = diagram.isRelative
        ? "Deviation as a multiple of the point's tolerance"
        : `Deviation${scene.units ? ` [${scene.units}]` : ''}`;
  };
  const choice = byId('diagram-unit');
  choice.value = diagram.isRelative ? 'relative' : 'length';
  byId('diagram-unit-control').hidden = !scene.hasTolerances;
  choice.addEventListener('change', () => {
    diagram.setRelative(choice.value === 'relative');
    title();
  });
  title();
}

fillHead();
fillSummary();
byId('main').classList.toggle('tall', scene.isTall);
if (scene.isMeasured) {
  fillHistogram(byId('histogram'), scene);
  setUpMagnify();
  setUpDiagram();
} else {
  byId('magnify-control').hidden = true;
  byId('diagram-part').hidden = true;
  byId('pieces').hidden = !scene.hasContour;
  byId('note').hidden = true;
  byId('main').classList.toggle('lone', !scene.hasContour);
  fillLegend(byId('legend'), scene);
}

matchMedia('(prefers-color-scheme: dark)').addEventListener('change', redraw);
const drawForPaper = () => {
  contour.surface.draw();
  diagram?.surface.draw();
};
matchMedia('print').addEventListener('change', drawForPaper);
addEventListener('beforeprint', drawForPaper);
addEventListener('afterprint', redraw);

/** For scripts that drive this page: where a point is, in pixels of its canvas. */
globalThis.contourReport = {
  pixelOf: (i) => contour.pixelOf(i),
  diagramPixelOf: (i) => diagram.pixelOf(i),
  hovered: () => state.hovered,
};
