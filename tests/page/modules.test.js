import assert from 'node:assert/strict';
import {readdirSync, readFileSync} from 'node:fs';
import {describe, it} from 'node:test';

const folder = new URL('../../io/drawing/html/', import.meta.url);
const lists = readFileSync(new URL('../../io/CMakeLists.txt', import.meta.url), 'utf8');
const scripts = /set\(script\s([^)]*)\)/.exec(lists)[1].trim().split(/\s+/);
const textOf = (name) => readFileSync(new URL(name, folder), 'utf8');

// The page holds the scripts one after the other in a single module.
describe('The scripts of the page', () => {
  it('are all in it', () => {
    const onDisk = readdirSync(folder).filter((name) => name.endsWith('.js'));
    assert.deepEqual([...scripts].sort(), onDisk.sort());
  });
  it('import only what stands before them', () => {
    scripts.forEach((name, i) => {
      for (const [, from] of textOf(name).matchAll(/^import [^;]* from '\.\/([^']+)';/gms)) {
        const at = scripts.indexOf(from);
        assert.ok(at >= 0 && at < i, `${name} imports ${from}`);
      }
    });
  });
  it('have no name twice', () => {
    const names = scripts.flatMap((name) => [...textOf(name).matchAll(
      /^(?:export )?(?:function|class|const|let) (\w+)/gm)].map(([, found]) => found));
    assert.ok(names.length > 30);
    assert.deepEqual(names, [...new Set(names)]);
  });
});
