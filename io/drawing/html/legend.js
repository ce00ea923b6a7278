// The legend of the drawing.

import {short} from './numbers.js';
import {FEW_POINTS} from './scene.js';
import {element, swatch} from './table.js';

/** What is drawn, as pairs of a picture and its words. */
export function legendEntries(scene) {
  const times = scene.times === 1 ? '' : ` \u00d7${short(scene.times)}`;
  const stroke = (color, dashes) => `<line x1="0" y1="7" x2="26" y2="7" stroke="var(--${color})" ` +
      `stroke-width="2.5" ${dashes ? 'stroke-dasharray="9 2.5"' : ''}/>`;
  const outline = 'stroke="var(--text)" stroke-width="1.1"';
  const entries = [];
  const hasKind = (kind) => scene.pieces.some((piece) => piece.kind === kind);
  if (scene.hasContour) {
    if (hasKind('line')) entries.push([stroke('line'), 'line']);
    if (hasKind('arc')) entries.push([stroke('arc', true), 'arc']);
    entries.push([`<circle cx="13" cy="7" r="3.6" fill="var(--paper)" ${outline}/>`, 'joint']);
  }
  entries.push([`<path d="M8 1.5L20 7L8 12.5z" fill="var(--start)" ${outline}/>`,
                scene.isClosed ? 'start and end' : 'start']);
  if (!scene.isClosed) {
    entries.push([`<rect x="9" y="3" width="8" height="8" fill="var(--paper)" ${outline}/>`,
                  'end']);
  }
  if (scene.isMeasured) {
    entries.push(['<circle cx="7" cy="7" r="2.5" fill="var(--point)"/>' +
                  '<rect x="16" y="4.8" width="4.4" height="4.4" fill="var(--point)"/>',
                  `point of a line, of an arc: deviation${times}` +
                      (scene.count > FEW_POINTS ? '; dense ones are bars' : '')],
                 ['<circle cx="13" cy="7" r="6" fill="none" stroke="var(--worst)" ' +
                  'stroke-width="2"/>',
                  'largest deviation']);
  } else if (scene.count > 0) {
    entries.push(['<circle cx="13" cy="7" r="2.5" fill="var(--point)"/>', 'measured point'],
                 ['<path d="M3 7h12M14 3.5L21 7L14 10.5z" fill="var(--start)" ' +
                  'stroke="var(--start)"/>',
                  'order']);
  }
  if (scene.hasTolerances) {
    entries.push(['<rect x="4" y="1.5" width="18" height="11" fill="var(--band)" ' +
                  'stroke="var(--band-edge)" stroke-width="1.2"/>', `tolerance${times}`]);
    if (scene.outside.length > 0) {
      entries.push(['<path d="M9.5 3.5l7 7m0-7l-7 7" stroke="var(--outside)" stroke-width="1.4"/>',
                    'outside tolerance']);
    }
  }
  return entries;
}

/** Writes the legend of the scene into the list. */
export function fillLegend(list, scene) {
  list.replaceChildren(...legendEntries(scene).map(([markup, words]) => {
    const entry = element('li');
    entry.append(swatch(markup, 26, 14), words);
    return entry;
  }));
}
