// What the tests share: a browser, a visitor with a session of his own, and the watch over
// everything that the portal sends him.
import assert from 'node:assert/strict';
import { mkdirSync, readFileSync } from 'node:fs';
import { createRequire } from 'node:module';
import { HtmlValidate } from 'html-validate';
import { chromium } from 'playwright-core';
import { wordsOf } from './words.mjs';

// Of a portal in each language.
const addresses = {
  et: process.env.ZEBTELL_URL,
  en: process.env.ZEBTELL_URL_EN,
  lv: process.env.ZEBTELL_URL_LV,
};
export const languages = Object.keys(addresses);
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
const axe = readFileSync(createRequire(import.meta.url).resolve('axe-core/axe.min.js'), 'utf8');

// What is sound HTML, if not to everybody's taste: option lists are written in capitals, addresses
// come with bare ampersands, buttons and inputs have their default types, and each column has a
// button of the same name.
const validator = new HtmlValidate({
  extends: ['html-validate:recommended'],
  rules: {
    'attr-case': 'off',
    'attr-quotes': 'off',
    'attribute-boolean-style': 'off',
    'doctype-style': 'off',
    'element-case': 'off',
    'form-dup-name': 'off',
    'long-title': 'off',
    'no-implicit-button-type': 'off',
    'no-implicit-input-type': 'off',
    'no-raw-characters': 'off',
    'no-trailing-whitespace': 'off',
  },
});

export async function openBrowser() {
  assert.ok(addresses.et, 'ZEBTELL_URL must hold the address of a running portal');
  return chromium.launch({ executablePath: chrome, args: flags });
}

export class Visitor {
  // `options` are the browser context's, and the language of the portal.
  static async enter(browser, { language = 'et', ...options } = {}) {
    const context = await browser.newContext({ locale: 'et-EE', ...options });
    context.setDefaultTimeout(10_000);
    const visitor = new Visitor(context, await context.newPage(), language);
    await visitor.page.goto(addresses[language]);
    return visitor;
  }

  constructor(context, page, language = 'et') {
    this.context = context;
    this.page = page;
    this.language = language;
    this.say = wordsOf(language);
    this.checks = [];
    this.watch(page);
  }

  // What the portal sends to the page is checked.
  watch(page) {
    page.on('console', (entry) => {
      if (entry.type() === 'error') this.checks.push(`${page.url()}: ${entry.text()}`);
    });
    page.on('response', (response) => this.checks.push(checkResponse(response, this.language)));
  }

  // Another tab of the same session.
  async openTab() {
    const tab = new Visitor(this.context, await this.context.newPage(), this.language);
    tab.checks = this.checks;
    return tab;
  }

  // Ends the session's browser side; fails when a page was not sound HTML, an answer was an error
  // or the browser had to refuse something.
  async leave() {
    const complaints = (await Promise.all(this.checks)).flat();
    await this.context.close();
    assert.equal(complaints.length, 0, complaints.slice(0, 10).join('\n'));
  }

  async go(query) {
    await this.page.goto(new URL(`?${query}`, addresses[this.language]).href);
    await Promise.all(this.checks);
  }

  // Does what leads to another page, and waits for that and for its check: a browser forgets what
  // it was sent when it goes on.
  async arrive(action) {
    await Promise.all([this.page.waitForEvent('domcontentloaded', { timeout: 60_000 }), action()]);
    await Promise.all(this.checks);
  }

  follow(locator) {
    return this.arrive(() => locator.click());
  }

  press(name) {
    return this.follow(this.page.getByRole('button', { name: this.say(name), exact: true }));
  }

  link(name) {
    return this.follow(this.page.getByRole('link', { name, exact: true }));
  }

  async logOn(name, password) {
    await this.page.getByLabel(this.say('Kasutajanimi')).fill(name);
    await this.page.getByLabel(this.say('Parool')).fill(password);
    await this.press('Sisene');
  }

  message() {
    return this.page.getByRole('alert').innerText();
  }

  heading() {
    return this.page.getByRole('heading', { level: 1 }).innerText();
  }

  async openCatalogue() {
    const menu = this.page.getByRole('navigation', { name: this.say('Põhimenüü') });
    await this.follow(menu.getByText(this.say('Kaubad')));
  }

  async search(text, group = this.say('Kõik kaubagrupid')) {
    await this.page.getByLabel(this.say('Kood või nimetus')).fill(text);
    await this.page.getByLabel(this.say('Kaubagrupp')).selectOption({ label: group });
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
    return this.page.getByRole('region', { name: this.say('Korv') });
  }

  basketSums() {
    return this.basket().locator('.read .summa').allInnerTexts();
  }

  // The value beside a label in a list of sums or data.
  async value(label) {
    const term = this.page.getByText(this.say(label), { exact: true });
    const line = this.page.locator('dl > div', { has: term });
    return (await line.locator('dd').innerText()).trim();
  }

  async order(quantities) {
    const boxes = this.page.locator('input.kogus[name^="ID_"]');
    for (const [index, quantity] of quantities.entries()) await boxes.nth(index).fill(quantity);
    await this.press('Lisa korvi');
  }

  // Takes the page in three widths; it must fit them, and a narrow phone, without sideways
  // scrolling.
  async photograph(name) {
    mkdirSync(screenshots, { recursive: true });
    for (const width of [320, 768, 1280, 390, 820, 1366]) {
      await this.page.setViewportSize({ width, height: 900 });
      await this.fits(`${name} at ${width} pixels`);
      if ([320, 768, 1280].includes(width)) continue;
      await this.page.screenshot({ path: `${screenshots}${name}-${width}.png`, fullPage: true });
    }
  }

  // Nothing is to be scrolled sideways, neither the page nor a part of it.
  async fits(what) {
    const wide = await this.page.evaluate(() => {
      const root = document.documentElement;
      const scrolling = [...document.querySelectorAll('body, main, main *')].filter(
        (e) => e.scrollWidth > e.clientWidth && /auto|scroll/.test(getComputedStyle(e).overflowX),
      );
      const excess = root.scrollWidth - window.innerWidth;
      return [...(excess > 0 ? [`page by ${excess}`] : []), ...scrolling.map((e) => e.className)];
    });
    assert.deepEqual(wide, [], `${what} has to be scrolled sideways`);
  }

  // What axe-core finds on the page, told with the places; `rules` are all that it has for the
  // levels A and AA and good practice, or those named.
  async accessibilityFaults(rules) {
    if (!(await this.page.evaluate(() => 'axe' in window))) await this.page.evaluate(axe);
    const found = await this.page.evaluate(async (only) => {
      const options = { resultTypes: ['violations'], ...(only && { runOnly: only }) };
      return (await window.axe.run(document, options)).violations.map(
        ({ id, help, nodes }) => `${id}: ${help}: ${nodes.map((n) => n.html).slice(0, 3)}`,
      );
    }, rules);
    return found.map((fault) => `${this.page.url()} (${this.language}): ${fault}`);
  }
}

// "1 234,50 €", or "1,234.50 €" in English, in cents.
export function cents(text) {
  const digits = text.replace(/[^\d.,-]/g, '');
  assert.match(digits, /^-?[\d.,]*\d[.,]\d\d$/, `not an amount: ${text}`);
  return Number(digits.replace(/[.,]/g, ''));
}

// The portal's option lists have no ends and capital letters, which HTML allows; the validator does
// not know the one, and has no rule to be switched off for the other.
const withPlainOptions = (text) =>
  text.replace(/<OPTION (SELECTED )?VALUE=("[^"]*")>([^<\r]*)\r\n/g, (_, selected, value, name) =>
    `<option ${selected ? 'selected ' : ''}value=${value}>${name}</option>\n`);

async function checkResponse(response, language) {
  const url = response.url();
  if (response.status() >= 400) return [`${response.status()} ${url}`];
  const type = response.headers()['content-type'] ?? '';
  if (response.status() >= 300 || !type.startsWith('text/html')) return [];
  const text = await response.text();
  const tags = [...text.matchAll(/<\/?zeb:[^>]*>/gi)];
  const problems = tags.map((tag) => `${url}: ${tag[0]} was sent`);
  if (!text.includes(`<html lang="${language}">`)) problems.push(`${url}: not in ${language}`);
  const report = await validator.validateString(withPlainOptions(text));
  for (const { messages } of report.results) {
    problems.push(...messages.map((m) => `${url}:${m.line}: ${m.message} (${m.ruleId})`));
  }
  return problems;
}
