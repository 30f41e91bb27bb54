// Buyers of all kinds order something: the same steps with other hands, screens and languages.
import assert from 'node:assert/strict';
import { after, before, describe, test } from 'node:test';
import { hands } from './hands.mjs';
import { Visitor, cents, languages, openBrowser } from './portal.mjs';

const phone = { viewport: { width: 390, height: 844 }, hasTouch: true, isMobile: true };
const timeout = 300_000;
let browser;

before(async () => (browser = await openBrowser()));
after(async () => browser?.close());

// A buyer who works the pages of the visitor with these hands.
function buyer(visitor, { press, write, choose } = hands.mouse) {
  const { page, say } = visitor;
  const named = (role, name) => page.getByRole(role, { name: say(name), exact: true });
  const follow = (locator) => visitor.arrive(() => press(locator));
  const quantities = page.locator('input.kogus[name^="ID_"]');
  return {
    async logOn() {
      await write(page.getByLabel(say('Kasutajanimi')), 'mari');
      await write(page.getByLabel(say('Parool')), 'mari-demo');
      await follow(named('button', 'Sisene'));
    },
    async seeAllProducts() {
      const menu = page.getByRole('navigation', { name: say('Põhimenüü') });
      await follow(menu.getByRole('link', { name: say('Kaubad') }));
      await choose(page.getByLabel(say('Kaubagrupp')), say('Kõik kaubagrupid'));
      await follow(named('button', 'Otsi'));
    },
    async add(amounts) {
      for (const [at, amount] of amounts.entries()) await write(quantities.nth(at), amount);
      await follow(named('button', 'Lisa korvi'));
    },
    async confirm(comment) {
      await follow(visitor.basket().getByRole('button', { name: say('Vormista'), exact: true }));
      await write(page.getByLabel(say('Soovitud tarnepäev')), '2030-03-03');
      await write(page.getByLabel(say('Märkused müüjale')), comment);
      await follow(named('button', 'Kinnita tellimus'));
    },
  };
}

// From the log-on page to the stored order; its number.
async function buy(visitor, tools) {
  const { say } = visitor;
  const mari = buyer(visitor, tools);
  await mari.logOn();
  await mari.seeAllProducts();
  const [first, second] = await visitor.rows();
  await mari.add(['2', '3']);
  const sums = [2 * cents(first.own), 3 * cents(second.own)];
  assert.deepEqual((await visitor.basketSums()).map(cents), sums);
  await mari.confirm('Helistada "enne" & <alles> siis');
  assert.equal(
    await visitor.page.getByRole('status').innerText(),
    say('Täname, tellimus on vastu võetud.'),
  );
  assert.deepEqual(
    (await visitor.rows()).map((row) => [row.code, row[say('Kogus')], cents(row[say('Summa')])]),
    [[first.code, '2', sums[0]], [second.code, '3', sums[1]]],
  );
  assert.equal(cents(await visitor.value('Ilma käibemaksuta')), sums[0] + sums[1]);
  assert.equal(await visitor.value('Märkused'), 'Helistada "enne" & <alles> siis');
  assert.match(await visitor.value('Soovitud tarnepäev'), /^03[./]03[./]2030$/);
  const number = (await visitor.heading()).split(' ').at(-1);
  assert.match(number, /\d/);
  return number;
}

// A visitor of his own for each; leaving checks what the portal sent meanwhile.
function visit(title, options, play) {
  test(title, { timeout }, async () => {
    const visitor = await Visitor.enter(browser, options);
    await play(visitor);
    await visitor.leave();
  });
}

describe('an order from log-on to its number', { concurrency: 3 }, () => {
  visit('with nothing but a keyboard', {}, (visitor) => buy(visitor, hands.keyboard));
  visit('with fingers on a phone', phone, async (visitor) => {
    await buy(visitor, hands.fingers);
    await visitor.fits('the stored order on a phone');
  });
  visit('without scripts', { javaScriptEnabled: false }, (visitor) => buy(visitor));
  visit('with a keyboard and without scripts', { javaScriptEnabled: false }, (visitor) =>
    buy(visitor, hands.keyboard));
  for (const language of languages) visit(`in ${language}`, { language }, (visitor) => buy(visitor));
});

describe('what browsers do', { concurrency: 3 }, () => {
  visit('two tabs of one session order once', {}, async (visitor) => {
    const other = await visitor.openTab();
    const [mari, alsoMari] = [buyer(visitor), buyer(other)];
    await mari.logOn();
    await mari.seeAllProducts();
    await other.go('page=Kaubainfo');
    await mari.add(['1']);
    await alsoMari.add(['', '4']);
    assert.equal((await other.basketSums()).length, 2, 'both tabs fill one basket');
    // This tab's basket has one row still; the other tab's row must not suffer for it.
    await visitor.basket().getByLabel('Kogus').first().fill('5');
    await visitor.press('Muuda');
    const held = visitor.basket().getByLabel('Kogus');
    assert.deepEqual([await held.nth(0).inputValue(), await held.nth(1).inputValue()], ['5', '4']);

    await visitor.press('Vormista');
    await other.go('page=Kinnitus');
    await visitor.press('Kinnita tellimus');
    const heading = await visitor.heading();
    assert.match(heading, /^Tellimus .*\d/);
    await other.press('Kinnita tellimus');
    assert.equal(await other.heading(), heading, 'the other tab comes to the same order');
  });

  visit('back and reload behind each post', {}, async (visitor) => {
    const { page } = visitor;
    const mari = buyer(visitor);
    const sums = () => visitor.basketSums();
    // What is seen stays as it is when the page is loaded again, and when one goes back and forth.
    const staysSo = async (what, see) => {
      const seen = await see();
      await visitor.arrive(() => page.reload());
      assert.deepEqual(await see(), seen, `${what}, loaded again`);
      await page.goBack();
      await page.goForward();
      assert.deepEqual(await see(), seen, `${what}, back and forth`);
      await visitor.arrive(() => page.reload());
      assert.deepEqual(await see(), seen, `${what}, back, forth and loaded again`);
    };
    await mari.logOn();
    await staysSo('the start page', () => visitor.heading());
    await mari.seeAllProducts();
    await staysSo('the list', () => visitor.rows());
    await mari.add(['2', '3']);
    await staysSo('the basket', sums);
    await visitor.basket().getByLabel('Kogus').first().fill('7');
    await visitor.press('Muuda');
    await staysSo('the changed basket', sums);
    await visitor.press('Vormista');
    await staysSo('the confirmation', () => visitor.rows());
    await visitor.press('Kinnita tellimus');
    await staysSo('the stored order', () => visitor.heading());
  });

  visit('a session that ended in between', {}, async (visitor) => {
    const mari = buyer(visitor);
    await mari.logOn();
    await mari.seeAllProducts();
    await mari.add(['2']);
    await visitor.context.clearCookies();
    await mari.add(['', '3']);
    assert.equal(await visitor.heading(), 'Sisenemine');
    assert.equal(await visitor.message(), 'Sessioon katkestatud - sisenege uuesti!');
    await mari.logOn();
    const told = visitor.page.getByRole('status');
    assert.match(await told.innerText(), /ei jõudnud korvi/);
    await visitor.arrive(() => visitor.page.reload());
    assert.equal(await told.count(), 0, 'it is told once');
    await visitor.go('page=Koostamine');
    await visitor.page.getByText('Korvis ei ole ühtegi rida').waitFor();
  });
});
