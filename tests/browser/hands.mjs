// Ways to work a page: with a mouse, with fingers, or with nothing but a keyboard.
import assert from 'node:assert/strict';

const mouse = {
  press: (locator) => locator.click(),
  write: (locator, text) => locator.fill(text),
  choose: (locator, label) => locator.selectOption({ label }),
};

const fingers = {
  ...mouse,
  press: (locator) => locator.tap(),
};

// Far beyond the stops of the longest page.
const mostStops = 200;

// Goes on with Tab until the element has the focus, which must be seen.
async function goTo(locator) {
  const page = locator.page();
  const isThere = () => locator.evaluate((element) => element === document.activeElement);
  for (let stops = 0; !(await isThere()); stops++) {
    assert.ok(stops < mostStops, `Tab does not lead to ${locator}`);
    await page.keyboard.press('Tab');
  }
  const ring = await locator.evaluate((element) => {
    const { outlineStyle, outlineWidth } = getComputedStyle(element);
    return outlineStyle === 'none' ? 0 : parseFloat(outlineWidth);
  });
  assert.ok(ring >= 2, `the focus on ${locator} is not seen`);
}

const keyboard = {
  async press(locator) {
    await goTo(locator);
    await locator.page().keyboard.press('Enter');
  },
  async write(locator, text) {
    await goTo(locator);
    await locator.page().keyboard.press('Control+A');
    // A date is typed part by part: these are day and month, or month and day, and the year.
    const date = /^(\d{4})-(\d\d)-\2$/.exec(text);
    await locator.page().keyboard.type(date ? date[2] + date[2] + date[1] : text);
  },
  async choose(locator, label) {
    await goTo(locator);
    await locator.page().keyboard.press('Home');
    const chosen = locator.locator('option:checked');
    for (let steps = 0; (await chosen.innerText()).trim() !== label; steps++) {
      assert.ok(steps < mostStops, `no choice ${label}`);
      await locator.page().keyboard.press('ArrowDown');
    }
  },
};

export const hands = { mouse, fingers, keyboard };
