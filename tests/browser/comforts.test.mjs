// The pages' own script: what it adds for the keyboard. The address comes in ZEBTELL_URL.
import assert from 'node:assert/strict';
import { after, before, test } from 'node:test';
import { Visitor, openBrowser } from './portal.mjs';

let browser;
before(async () => (browser = await openBrowser()));
after(async () => browser?.close());

test('quantities go from row to row', { timeout: 60_000 }, async () => {
  const visitor = await Visitor.enter(browser);
  const { page } = visitor;
  const keys = async (...names) => {
    for (const name of names) await page.keyboard.press(name);
  };
  // Which quantity box has the focus, or what else.
  const place = () =>
    page.evaluate(() => {
      const boxes = [...document.querySelectorAll('input.kogus[name^="ID_"]')];
      const at = boxes.indexOf(document.activeElement);
      return at < 0 ? document.activeElement.id || document.activeElement.textContent : at;
    });
  await visitor.logOn('mari', 'mari-demo');
  await visitor.openCatalogue();
  await visitor.search('');
  assert.equal(await place(), 'tekst');
  await keys('ArrowDown', '2', 'Enter', '3', 'Tab', 'Tab', '4', 'ArrowUp', 'ArrowDown', 'Enter');
  assert.equal(await place(), 4);
  await keys('Shift+Tab');
  assert.equal(await place(), (await visitor.rows())[4].name);
  await keys('Tab', 'Shift+Enter', 'ArrowUp');
  assert.equal(await place(), 2);
  const boxes = page.locator('input.kogus[name^="ID_"]');
  await boxes.last().focus();
  await keys('Enter');
  assert.equal(await place(), 'Lisa korvi');
  await visitor.arrive(() => page.keyboard.press('Enter'));
  assert.match(await page.getByRole('status').innerText(), /Korvi lisatud ridu: 3\./);
  assert.deepEqual(
    await page.locator('.korv .kogus').evaluateAll((typed) => typed.map((box) => box.value)),
    ['2', '3', '4'],
  );
  await visitor.leave();
});

test('rows from a spreadsheet find the field for many', { timeout: 60_000 }, async () => {
  const visitor = await Visitor.enter(browser);
  const { page } = visitor;
  await visitor.logOn('mari', 'mari-demo');
  await visitor.openCatalogue();
  const codes = (await visitor.rows()).slice(0, 2).map((row) => row.code);
  await page.getByText('Kiirsisestus koodi järgi').click();
  const paste = (text) =>
    page.getByLabel('Kood, 1. rida').evaluate((box, pasted) => {
      const clipboardData = new DataTransfer();
      clipboardData.setData('text', pasted);
      box.dispatchEvent(new ClipboardEvent('paste', { clipboardData, cancelable: true }));
    }, text);
  await paste(`${codes[0]}\t7\r\n${codes[1]}\tkaks\r\n`);
  await paste('PUUDUB\t1');
  await visitor.press('Lisa koodid korvi');
  assert.match(await visitor.message(), /kaks.*PUUDUB/);
  const left = page.getByLabel('Või mitu rida korraga');
  assert.equal(await left.inputValue(), `${codes[1]}\tkaks\nPUUDUB\t1\n`);
  assert.equal(await left.getAttribute('aria-invalid'), 'true');
  await left.fill(`${codes[1]}\t2`);
  await visitor.press('Lisa koodid korvi');
  assert.equal(await left.inputValue(), '');
  assert.deepEqual(
    await page.locator('.korv .kogus').evaluateAll((typed) => typed.map((box) => box.value)),
    ['7', '2'],
  );
  await visitor.leave();
});
