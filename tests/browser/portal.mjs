// What the tests share: a browser, a visitor with a session of his own, and the watch over
// everything that the portal sends him.
import assert from 'node:assert/strict';
import { mkdirSync } from 'node:fs';
import { HtmlValidate } from 'html-validate';
import { chromium } from 'playwright-core';

const address = process.env.ZEBTELL_URL;
const chrome = process.env.CHROMIUM ?? '/usr/bin/chromium';
const flags = [
  '--no-sandbox',
  '--disable-gpu',
  '--disable-background-networking',
  '--disable-component-update',
  '--disable-sync',
  '--no-first-run',
];
const screenshots = new URL('./screenshots/', import.meta.url).pathname;

// What is sound HTML, if not to everybody's taste: option lists are written in capitals, addresses
// come with bare ampersands, and buttons and inputs have their default types.
const validator = new HtmlValidate({
  extends: ['html-validate:recommended'],
  rules: {
    'attr-case': 'off',
    'attr-quotes': 'off',
    'attribute-boolean-style': 'off',
    'doctype-style': 'off',
    'element-case': 'off',
    'long-title': 'off',
    'no-implicit-button-type': 'off',
    'no-implicit-input-type': 'off',
    'no-raw-characters': 'off',
    'no-trailing-whitespace': 'off',
  },
});

export async function openBrowser() {
  assert.ok(address, 'ZEBTELL_URL must hold the address of a running portal');
  return chromium.launch({ executablePath: chrome, args: flags });
}

export class Visitor {
  static async enter(browser) {
    const context = await browser.newContext({ locale: 'et-EE' });
    context.setDefaultTimeout(10_000);
    const visitor = new Visitor(context, await context.newPage());
    await visitor.page.goto(address);
    return visitor;
  }

  constructor(context, page) {
    this.context = context;
    this.page = page;
    this.checks = [];
    page.on('console', (entry) => {
      if (entry.type() === 'error') this.checks.push(`${page.url()}: ${entry.text()}`);
    });
    page.on('response', (response) => this.checks.push(checkResponse(response)));
  }

  // Ends the session's browser side; fails when a page was not sound HTML, an answer was an error
  // or the browser had to refuse something.
  async leave() {
    const complaints = (await Promise.all(this.checks)).flat();
    await this.context.close();
    assert.equal(complaints.length, 0, complaints.slice(0, 10).join('\n'));
  }

  async go(query) {
    await this.page.goto(new URL(`?${query}`, address).href);
    await Promise.all(this.checks);
  }

  // Does what leads to another page, and waits for that and for its check: a browser forgets what
  // it was sent when it goes on.
  async arrive(action) {
    await Promise.all([this.page.waitForEvent('domcontentloaded'), action()]);
    await Promise.all(this.checks);
  }

  follow(locator) {
    return this.arrive(() => locator.click());
  }

  press(name) {
    return this.follow(this.page.getByRole('button', { name, exact: true }));
  }

  link(name) {
    return this.follow(this.page.getByRole('link', { name, exact: true }));
  }

  async logOn(name, password) {
    await this.page.getByLabel('Kasutajanimi').fill(name);
    await this.page.getByLabel('Parool').fill(password);
    await this.press('Sisene');
  }

  message() {
    return this.page.getByRole('alert').innerText();
  }

  heading() {
    return this.page.getByRole('heading', { level: 1 }).innerText();
  }

  async openCatalogue() {
    const menu = this.page.getByRole('navigation', { name: 'Põhimenüü' });
    await this.follow(menu.getByText('Kaubad'));
  }

  async search(text, group = 'Kõik kaubagrupid') {
    await this.page.getByLabel('Kood või nimetus').fill(text);
    await this.page.getByLabel('Kaubagrupp').selectOption({ label: group });
    await this.press('Otsi');
  }

  // The rows of the page's table: texts of its cells, by their classes and labels.
  rows() {
    return this.page.locator('table.kaardid tbody tr').evaluateAll((rows) =>
      rows.map((row) => {
        const text = (selector) => row.querySelector(selector)?.innerText.trim() ?? '';
        const labelled = Object.fromEntries(
          [...row.querySelectorAll('td[data-label]')].map((cell) => [
            cell.dataset.label,
            cell.innerText.trim(),
          ]),
        );
        const own = text('.oma b');
        return { code: text('.kood'), name: text('.nimi'), own, ...labelled };
      }),
    );
  }

  basket() {
    return this.page.getByRole('region', { name: 'Korv' });
  }

  basketSums() {
    return this.basket().locator('.read .summa').allInnerTexts();
  }

  // The value beside a label in a list of sums or data.
  async value(label) {
    const term = this.page.getByText(label, { exact: true });
    const line = this.page.locator('dl > div', { has: term });
    return (await line.locator('dd').innerText()).trim();
  }

  async order(quantities) {
    const boxes = this.page.locator('input.kogus[name^="ID_"]');
    for (const [index, quantity] of quantities.entries()) await boxes.nth(index).fill(quantity);
    await this.press('Lisa korvi');
  }

  // Takes the page in three widths; it must fit them, and a narrow phone, without sideways
  // scrolling, and so must its table.
  async photograph(name) {
    mkdirSync(screenshots, { recursive: true });
    for (const width of [320, 768, 1280, 390, 820, 1366]) {
      await this.page.setViewportSize({ width, height: 900 });
      const excess = await this.page.evaluate(
        () =>
          Math.max(
            document.documentElement.scrollWidth - window.innerWidth,
            ...[...document.querySelectorAll('.kerib')].map((e) => e.scrollWidth - e.clientWidth),
          ),
      );
      assert.ok(excess <= 0, `${name} is ${excess} pixels too wide for ${width}`);
      if ([320, 768, 1280].includes(width)) continue;
      await this.page.screenshot({ path: `${screenshots}${name}-${width}.png`, fullPage: true });
    }
  }
}

// "1 234,50 €" in cents.
export function cents(text) {
  const digits = text.replace(/[^\d,-]/g, '');
  assert.match(digits, /^-?\d+,\d\d$/, `not an amount: ${text}`);
  return Number(digits.replace(',', ''));
}

// HTML allows an option without its end; the validator does not know that.
const withOptionEnds = (text) => text.replace(/(<OPTION [^>]*>[^<\r]*)\r\n/g, '$1</OPTION>\n');

async function checkResponse(response) {
  const url = response.url();
  if (response.status() >= 400) return [`${response.status()} ${url}`];
  const type = response.headers()['content-type'] ?? '';
  if (response.status() >= 300 || !type.startsWith('text/html')) return [];
  const text = await response.text();
  const tags = [...text.matchAll(/<\/?zeb:[^>]*>/gi)];
  const problems = tags.map((tag) => `${url}: ${tag[0]} was sent`);
  const report = await validator.validateString(withOptionEnds(text));
  for (const { messages } of report.results) {
    problems.push(...messages.map((m) => `${url}:${m.line}: ${m.message} (${m.ruleId})`));
  }
  return problems;
}
