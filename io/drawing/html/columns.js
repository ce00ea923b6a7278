// The columns of the table of the pieces.

import {decimalsFor, decimalsOfRelatives, fixed} from './numbers.js';

const degrees = (radians, decimals = 3) => fixed(radians * 180 / Math.PI, decimals);

/** How many digits lengths have: to a hundredth of the smallest tolerance, else of the size. */
export function lengthDecimals(scene) {
  if (scene.hasTolerances) return decimalsFor(scene.smallestTolerance);
  const box = scene.box();
  return decimalsFor(Math.max(box[2] - box[0], box[3] - box[1]) / 1000);
}

/** Degrees and an arrow for the direction. */
export function sweepText(piece) {
  return `${degrees(piece.sweep)}\u00b0 ${piece.ccw ? '\u21ba' : '\u21bb'}`;
}

/** The largest deviation of a piece, over the tolerance where there is one; null without points. */
export function worstOf(scene, piece) {
  if (piece.worst < 0) return null;
  return Math.abs(scene.hasTolerances ? scene.relative(piece.worst)
                                      : scene.deviation(piece.worst));
}

/**
 * Head, text of a piece, and whether the column is among the few beside the drawing. Columns of
 * numbers have as many digits after the point in every row.
 */
export function columnsOf(scene) {
  const decimals = lengthDecimals(scene);
  const length = (value) => fixed(value, decimals);
  const finer = (value) => fixed(value, decimals + 1);
  const ofArc = (text) => (piece) => (piece.kind === 'arc' ? text(piece) : '');
  const column = (head, text, isMain = false) => ({head, text, isMain});
  const known = (value, text) => (value === null || value === undefined ? '' : text(value));
  const columns = [
    column('start x', (piece) => length(piece.start[0])),
    column('start y', (piece) => length(piece.start[1])),
    column('end x', (piece) => length(piece.end[0])),
    column('end y', (piece) => length(piece.end[1])),
    column('centre x', ofArc((piece) => length(piece.center[0]))),
    column('centre y', ofArc((piece) => length(piece.center[1]))),
    column('length', (piece) => length(piece.length), true),
    column(scene.isMeasured ? 'fitted radius' : 'radius',
           ofArc((piece) => length(piece.radius)), true),
    column('sweep', ofArc(sweepText), !scene.isMeasured),
    column('turn to next', (piece) => known(piece.turn, (turn) => `${degrees(turn)}\u00b0`)),
  ];
  if (!scene.isMeasured) return columns;
  const measured = (name, text) => (piece) => known(piece.measured?.[name], text);
  columns.push(
    column('measured radius', measured('radius', length), true),
    column('\u00b1', measured('radiusDeviation', finer)),
    column('measured direction', measured('direction', (angle) => `${degrees(angle)}\u00b0`)),
    column('\u00b1', measured('directionDeviation',
                               (angle) => `${degrees(angle, 4)}\u00b0`)),
    column('form error', measured('formError', finer), true),
    column('std. deviation', measured('standardDeviation', finer)),
    column('points', (piece) => String(piece.points), true),
    worstColumn(scene, decimals));
  return columns;
}

function worstColumn(scene, decimals) {
  const worst = scene.pieces.map((piece) => worstOf(scene, piece));
  const digits = scene.hasTolerances
      ? decimalsOfRelatives(worst.filter((value) => value !== null)) : decimals + 1;
  return {head: scene.hasTolerances ? 'of tolerance' : 'deviation', isMain: true, isWorst: true,
          text: (piece) => {
            const value = worstOf(scene, piece);
            return value === null ? '' : fixed(value, digits);
          }};
}
