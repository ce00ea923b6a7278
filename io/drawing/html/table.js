// The table of the pieces beside the drawing.

import {short} from './numbers.js';
import {LARGEST_RELATIVE} from './scene.js';

export class PieceTable {
  /** @param actions hover(index or -1), choose(index) */
  constructor(scene, actions) {
    this.scene = scene;
    this.actions = actions;
    this.body = document.getElementById('rows');
    const heads = ['no', 'kind', 'length', 'radius', 'sweep'];
    if (scene.isMeasured) heads.push('points', scene.hasTolerances ? 'of tolerance' : 'deviation');
    for (const head of heads) document.getElementById('columns').append(element('th', head));
    this.body.append(...scene.pieces.map((piece, i) => this.row(piece, i)));
    this.listen();
  }

  row(piece, i) {
    const isArc = piece.kind === 'arc';
    const row = element('tr');
    row.dataset.piece = i;
    row.tabIndex = 0;
    const kind = element('td');
    kind.append(swatch(isArc ? '<line x1="0" y1="4" x2="22" y2="4" stroke="var(--arc)" ' +
                               'stroke-width="2.5" stroke-dasharray="8 2"/>'
                             : '<line x1="0" y1="4" x2="22" y2="4" stroke="var(--line)" ' +
                               'stroke-width="2.5"/>', 22, 8),
                isArc ? 'arc' : 'line');
    row.append(element('td', String(i + 1)), kind, element('td', short(piece.length)),
               element('td', isArc ? short(piece.radius) : ''),
               element('td', isArc ? this.sweep(piece) : ''));
    if (this.scene.isMeasured) {
      row.append(element('td', String(piece.points)), this.worstCell(piece));
    }
    return row;
  }

  /** Degrees, without a sign as everywhere, and an arrow for the direction. */
  sweep(piece) {
    return `${short(piece.sweep * 180 / Math.PI, 5)}\u00b0 ${piece.ccw ? '\u21ba' : '\u21bb'}`;
  }

  worstCell(piece) {
    const {scene} = this;
    if (piece.worst < 0) return element('td', '');
    const value = Math.abs(scene.hasTolerances ? scene.relative(piece.worst)
                                               : scene.deviation(piece.worst));
    const cell = element('td', short(value, 4));
    if (!scene.hasTolerances) return cell;
    cell.className = 'share';
    const bar = element('i');
    bar.style.width = `${Math.min(100, 100 * value)}%`;
    bar.classList.toggle('outside', !(value <= LARGEST_RELATIVE));
    cell.append(bar);
    return cell;
  }

  listen() {
    const pieceOf = (event) => {
      const row = event.target.closest('tr');
      return row ? Number(row.dataset.piece) : -1;
    };
    this.body.addEventListener('pointerover', (event) => this.actions.hover(pieceOf(event)));
    this.body.addEventListener('pointerleave', () => this.actions.hover(-1));
    this.body.addEventListener('click', (event) => this.actions.choose(pieceOf(event)));
    this.body.addEventListener('keydown', (event) => {
      if (event.key === 'Enter') this.actions.choose(pieceOf(event));
    });
  }

  mark(state) {
    for (const [name, index] of [['hovered', state.hoveredPiece], ['chosen', state.chosen]]) {
      const row = index >= 0 ? this.body.children[index] : null;
      const marked = this.body.querySelector(`.${name}`);
      if (marked === row) continue;
      marked?.classList.remove(name);
      row?.classList.add(name);
    }
  }

  scrollTo(index) {
    if (index >= 0) this.body.children[index].scrollIntoView({block: 'nearest'});
  }
}

export function element(name, text = '') {
  const made = document.createElement(name);
  made.textContent = text;
  return made;
}

/** A small drawing made of our own markup, never of data. */
export function swatch(markup, width, height) {
  const holder = document.createElement('span');
  holder.innerHTML = `<svg viewBox="0 0 ${width} ${height}" aria-hidden="true">${markup}</svg>`;
  return holder.firstChild;
}
