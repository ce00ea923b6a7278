// Pieces and pages for the tests.

export function line(start, end) {
  return {kind: 'line', start, end, length: Math.hypot(end[0] - start[0], end[1] - start[1])};
}

/** An arc about a centre from an angle over a sweep, both in radians. */
export function arc(center, radius, startAngle, sweep, ccw = true) {
  const at = (angle) => [center[0] + radius * Math.cos(angle),
                         center[1] + radius * Math.sin(angle)];
  return {kind: 'arc', center, radius, startAngle, sweep, ccw, length: radius * sweep,
          start: at(startAngle), end: at(startAngle + (ccw ? sweep : -sweep))};
}

/** The data of a page without points: what the pieces need. */
export function contourData(pieces) {
  return {points: {x: [], y: [], w: null}, pieces, deviations: null, magnify: 1, worst: -1,
          isClosed: false};
}

/**
 * A segment from (0, 0) to (10, 0) with points at x = 0, 5 and 10 that are `offsets` to its left.
 * @param w tolerance of all points, or of each
 * @param outside indexes of the points outside it
 */
export function measuredData(offsets, w, outside = []) {
  const x = [0, 5, 10];
  return {
    points: {x, y: offsets, w},
    pieces: [line([0, 0], [10, 0])],
    deviations: {signed: offsets, piece: [0, 0, 0], outside},
    magnify: 100,
    worst: 0,
    isClosed: false,
  };
}
