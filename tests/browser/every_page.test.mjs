// Every page in every language: accessible in light and dark, and readable on a narrow screen and
// at twice the size. That it is sound HTML is looked at on the way.
import assert from 'node:assert/strict';
import { after, before, describe, test } from 'node:test';
import { Visitor, languages, openBrowser } from './portal.mjs';

const timeout = 300_000;
let browser;

before(async () => (browser = await openBrowser()));
after(async () => browser?.close());

const narrow = { width: 320, height: 800 };
// What 1280 by 1024 pixels leave at 200 %.
const zoomed = { width: 640, height: 512 };
const wide = { width: 1280, height: 1024 };
const contrast = ['color-contrast', 'link-in-text-block'];

async function inspect(visitor, name) {
  const { page } = visitor;
  const faults = await visitor.accessibilityFaults();
  await page.emulateMedia({ colorScheme: 'dark' });
  faults.push(...(await visitor.accessibilityFaults(contrast)));
  await page.emulateMedia({ colorScheme: 'light' });
  for (const size of [narrow, zoomed]) {
    await page.setViewportSize(size);
    await visitor.fits(`${name} at ${size.width} pixels`);
  }
  await page.setViewportSize(wide);
  return faults;
}

// All pages, in an order in which each has something to show; with their empty and faulty states.
async function* pages(visitor) {
  const { page, say } = visitor;
  const at = async (query) => {
    await visitor.go(`page=${query}`);
    return query;
  };
  yield 'Logon';
  await visitor.logOn('mari', 'wrong');
  yield 'Logon with its message';
  await visitor.logOn('mari', 'mari-demo');
  for (const empty of ['Raamistik', 'Koostamine', 'Kinnitus', 'Tellimus']) yield `empty ${await at(empty)}`;
  await visitor.openCatalogue();
  await visitor.search('no such thing');
  yield 'Kaubainfo that found nothing';
  await visitor.search('');
  await visitor.order(['2', 'x']);
  yield 'Kaubainfo with a refused quantity';
  await visitor.follow(page.locator('th.nimi a').first());
  yield 'KInfo';
  for (const plain of ['Raamistik', 'Vasak', 'Yld', 'Kasutaja', 'Koostamine', 'Lisatud']) yield await at(plain);
  yield await at('Lisamine');
  yield await at('Kinnitus');
  await visitor.press('Kinnita tellimus');
  yield 'Tellimus, just stored';
  yield await at('Kinnitatud');
  await visitor.openCatalogue();
  await visitor.link(say('Logi välja'));
  yield 'Logout';
}

describe('every page', { concurrency: 3 }, () => {
  for (const language of languages) {
    test(`in ${language}`, { timeout }, async () => {
      const visitor = await Visitor.enter(browser, { language, viewport: wide });
      const faults = [];
      for await (const name of pages(visitor)) faults.push(...(await inspect(visitor, name)));
      await visitor.leave();
      assert.deepEqual(faults, []);
    });
  }
});
