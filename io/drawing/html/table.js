// The table of the pieces beside the drawing.

import {columnsOf, worstOf} from './columns.js';

export class PieceTable {
  /** @param actions hover(index or -1), choose(index) */
  constructor(scene, actions) {
    this.scene = scene;
    this.actions = actions;
    this.body = document.getElementById('rows');
    this.columns = columnsOf(scene);
    const heads = [{head: 'no', isMain: true}, {head: 'kind', isMain: true}, ...this.columns];
    for (const {head, isMain} of heads) {
      document.getElementById('columns').append(this.sorted(element('th', head), isMain));
    }
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
    row.append(element('td', String(i + 1)), kind);
    for (const column of this.columns) {
      const cell = element('td', column.text(piece));
      if (column.isWorst && this.scene.hasTolerances) this.addBar(cell, piece);
      row.append(this.sorted(cell, column.isMain));
    }
    return row;
  }

  /** Cells of the columns that are not among the few have a class. */
  sorted(cell, isMain) {
    cell.classList.toggle('more', !isMain);
    return cell;
  }

  addBar(cell, piece) {
    const value = worstOf(this.scene, piece);
    if (value === null) return;
    cell.classList.add('share');
    const bar = element('i');
    bar.style.width = `${Math.min(100, 100 * value)}%`;
    bar.classList.toggle('outside', this.scene.isOutside(piece.worst));
    cell.append(bar);
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
