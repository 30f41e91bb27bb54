// What the portal's pages say in each language, from the catalogues that they are translated by.
import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';

const folder = new URL('../../templates/translations/', import.meta.url);

function readCatalogue(language) {
  const texts = new Map();
  const quoted = (lines) => lines.trim().split('\n').map((line) => JSON.parse(line)).join('');
  const entry = /^msgid ((?:".*"\n)+)msgstr ((?:".*"\n?)+)/gm;
  for (const [, text, translation] of readFileSync(new URL(`${language}.po`, folder), 'utf8').matchAll(entry)) {
    texts.set(quoted(text), quoted(translation));
  }
  return texts;
}

// The function that says an Estonian text of the templates in a language.
export function wordsOf(language) {
  if (language === 'et') return (text) => text;
  const texts = readCatalogue(language);
  return (text) => {
    assert.ok(texts.get(text), `no "${text}" in ${language}`);
    return texts.get(text);
  };
}
