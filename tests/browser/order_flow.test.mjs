// A buyer's week against a running portal with the demo company: the address comes in ZEBTELL_URL.
import assert from 'node:assert/strict';
import { after, before, test } from 'node:test';
import { Visitor, cents, openBrowser } from './portal.mjs';

const pageLength = 20;
let browser;

before(async () => (browser = await openBrowser()));
after(async () => browser?.close());

// A visitor of his own for each test; leaving checks what the portal sent meanwhile. Steps build on
// those before them, so the first that fails is the last.
function visit(title, play) {
  test(title, { timeout: 300_000 }, async (t) => {
    const visitor = await Visitor.enter(browser);
    const step = async (name, work) => {
      let failure;
      await t.test(name, () => work().catch((error) => { throw (failure = error); }));
      if (failure) throw new Error(`stopped at "${name}"`);
    };
    await play(visitor, step);
    await visitor.leave();
  });
}

const total = (amounts) => amounts.map(cents).reduce((sum, amount) => sum + amount, 0);
const isSorted = (numbers) => numbers.every((n, i) => i === 0 || numbers[i - 1] <= n);

async function enterAsMari(visitor) {
  await visitor.logOn('mari', 'mari-demo');
  await visitor.openCatalogue();
}

visit('a buyer finds articles', async (visitor, step) => {
  const { page } = visitor;
  await visitor.logOn('mari', 'mari-demo');
  assert.match(await visitor.heading(), /^Tere, .+!$/);

  await step('the catalogue opens with what was bought before', async () => {
    await visitor.openCatalogue();
    const group = page.getByLabel('Kaubagrupp').locator('option:checked');
    assert.equal((await group.innerText()).trim(), 'Varem ostetud');
    assert.ok((await visitor.rows()).length > 0);
  });

  await step('a category is shown page by page', async () => {
    await visitor.search('');
    await visitor.press('Otsi');
    const first = await visitor.rows();
    assert.equal(first.length, pageLength);
    assert.ok(isSorted(first.map((row) => row.code)), 'sorted by code at first');
    const leaf = page.getByText(/^Leht \d+ \/ \d+$/);
    const count = Number((await leaf.innerText()).split('/')[1]);
    assert.ok(count > 2);

    await visitor.link('Järgmine ›');
    assert.equal(await leaf.innerText(), `Leht 2 / ${count}`);
    const second = await visitor.rows();
    assert.ok(second[0].code > first.at(-1).code);
    await visitor.link('Viimane leht');
    assert.equal(await leaf.innerText(), `Leht ${count} / ${count}`);
    assert.equal(await page.getByRole('link', { name: 'Järgmine ›' }).count(), 0);
    await visitor.link('Esimene leht');
    assert.deepEqual(await visitor.rows(), first);
  });

  await step('a group holds fewer articles than all groups', async () => {
    const groups = await page.getByLabel('Kaubagrupp').locator('option').allInnerTexts();
    const group = groups.at(-1).trim();
    const all = await visitor.rows();
    await visitor.search('', group);
    const some = await visitor.rows();
    assert.ok(some.length > 0);
    assert.notDeepEqual(some, all);
    const chosen = page.getByLabel('Kaubagrupp').locator('option:checked');
    assert.equal((await chosen.innerText()).trim(), group);
  });

  await step('sorting by price turns round', async () => {
    const prices = async () => (await visitor.rows()).map((row) => cents(row.Hind));
    await visitor.press('Hind');
    const rising = await prices();
    assert.ok(isSorted(rising), rising.join(' '));
    const header = page.getByRole('columnheader', { name: 'Hind', exact: true });
    assert.equal(await header.getAttribute('aria-sort'), 'ascending');
    await visitor.press('Hind');
    assert.ok(isSorted((await prices()).reverse()));
    assert.equal(await header.getAttribute('aria-sort'), 'descending');
  });

  await step('search finds by the beginning of the code and by words of the name', async () => {
    await visitor.openCatalogue();
    const [sample] = await visitor.rows();
    await visitor.search(sample.code);
    assert.ok((await visitor.rows()).some((row) => row.code === sample.code));
    const words = sample.name.split(/\s+/).slice(0, 2);
    await visitor.search(words.join(' '));
    const found = await visitor.rows();
    const holds = (row, word) => row.name.toLowerCase().includes(word.toLowerCase());
    assert.ok(found.length > 0);
    assert.ok(found.every((row) => words.every((word) => holds(row, word))));
  });

  await step('what was typed is shown as typed, and nothing found is said', async () => {
    const typed = '<b id="x">tühi</b> & "jutt"';
    await visitor.search(typed);
    assert.equal(await page.getByLabel('Kood või nimetus').inputValue(), typed);
    assert.equal(await page.locator('#x').count(), 0);
    assert.equal((await visitor.rows()).length, 0);
    await page.getByRole('heading', { name: 'Siin ei ole ühtegi kaupa' }).waitFor();
  });

  await step('an article has a page of its own', async () => {
    await visitor.search('');
    const [sample] = await visitor.rows();
    await visitor.link(sample.name);
    assert.equal(await visitor.heading(), sample.name);
    assert.equal(await visitor.value('Kood'), sample.code);
    assert.equal(await page.locator('.hind b').innerText(), `${sample.own} €`);
    await page.getByLabel('Kogus').fill('7');
    await visitor.press('Lisa korvi');
    assert.match(await page.getByRole('status').innerText(), /Korvi lisatud ridu: 1\./);
    assert.deepEqual((await visitor.basketSums()).map(cents), [7 * cents(sample.own)]);
  });
});

visit('a buyer orders', async (visitor, step) => {
  const { page } = visitor;
  await enterAsMari(visitor);
  let chosen;
  let number;

  await step('typed quantities go to the basket at the own price', async () => {
    chosen = (await visitor.rows()).slice(0, 2);
    await visitor.order(['2', '3']);
    const expected = [2 * cents(chosen[0].own), 3 * cents(chosen[1].own)];
    assert.deepEqual((await visitor.basketSums()).map(cents), expected);
    assert.equal(cents(await visitor.value('Kokku ilma km-ta')), expected[0] + expected[1]);
  });

  await step('the same article again gets more quantity, not a second row', async () => {
    await visitor.order(['1']);
    assert.deepEqual((await visitor.basketSums()).map(cents), [
      3 * cents(chosen[0].own),
      3 * cents(chosen[1].own),
    ]);
  });

  await step('quantities and comments are changed in the basket', async () => {
    const basket = visitor.basket();
    await basket.getByLabel('Kogus').first().fill('5');
    await basket.getByLabel('Märkus').nth(1).fill('<i>lõigata</i> 1,2 m');
    await visitor.press('Muuda');
    assert.equal(await basket.getByLabel('Kogus').first().inputValue(), '5');
    assert.equal(await basket.getByLabel('Märkus').nth(1).inputValue(), '<i>lõigata</i> 1,2 m');
    const sums = await visitor.basketSums();
    assert.equal(cents(sums[0]), 5 * cents(chosen[0].own));
    assert.equal(cents(await visitor.value('Kokku ilma km-ta')), total(sums));
  });

  await step('quick entry adds by code and names what it does not know', async () => {
    const known = (await visitor.rows())[2];
    await page.getByText('Kiirsisestus koodi järgi').click();
    await page.getByLabel('Kood, 1. rida').fill(known.code);
    await page.getByLabel('Kogus, 1. rida').fill('1,5');
    await page.getByLabel('Kood, 2. rida').fill('<puudub>');
    await page.getByLabel('Kogus, 2. rida').fill('1');
    await visitor.press('Lisa koodid korvi');
    assert.ok((await visitor.message()).includes('<puudub>'));
    assert.equal((await visitor.basketSums()).length, 3);
    assert.equal(await visitor.basket().getByLabel('Kogus').nth(2).inputValue(), '1,5');
  });

  await step('a row is taken out', async () => {
    await visitor.follow(visitor.basket().getByRole('link', { name: /^Eemalda/ }).nth(2));
    assert.equal(await visitor.heading(), 'Kaubad');
    assert.equal((await visitor.basketSums()).length, 2);
    await visitor.go('page=Koostamine');
    assert.deepEqual(
      (await visitor.rows()).map((row) => row.code),
      chosen.map((row) => row.code),
    );
    await visitor.press('Lisa ridu');
  });

  await step('the pages fit phones, tablets and screens', async () => {
    await visitor.photograph('kaubad');
    for (const name of ['Raamistik', 'Koostamine', 'Kinnitus', 'Kasutaja', 'Yld', 'Vasak']) {
      await visitor.go(`page=${name}`);
      await visitor.photograph(name.toLowerCase());
    }
    await visitor.openCatalogue();
  });

  await step('going on takes quantities along that were only typed', async () => {
    const quantity = visitor.basket().getByLabel('Kogus').first();
    await quantity.fill('6');
    await visitor.press('Vormista');
    assert.equal((await visitor.rows())[0].Kogus, '6');
    await visitor.press('Tagasi');
    await quantity.fill('5');
  });

  await step('the basket can be confirmed without scrolling to its end', async () => {
    await page.setViewportSize({ width: 1280, height: 720 });
    const box = await page.getByRole('button', { name: 'Vormista' }).boundingBox();
    assert.ok(box.y + box.height <= 720, `the button ends at ${box.y + box.height}`);
  });

  await step('going back from the confirmation keeps what was typed', async () => {
    await visitor.press('Vormista');
    await page.getByLabel('Soovitud tarnepäev').fill('2030-03-07');
    await page.getByLabel('Märkused müüjale').fill('Helistada </textarea> enne');
    await visitor.press('Tagasi');
    assert.equal(await visitor.heading(), 'Kaubad');
    await visitor.press('Vormista');
    assert.equal(await page.getByLabel('Soovitud tarnepäev').inputValue(), '2030-03-07');
    const comment = await page.getByLabel('Märkused müüjale').inputValue();
    assert.equal(comment, 'Helistada </textarea> enne');
  });

  await step('Enter in a field does not store or drop the order', async () => {
    await visitor.arrive(() => page.getByLabel('Soovitud tarnepäev').press('Enter'));
    await visitor.go('page=Kinnitus');
    assert.equal((await visitor.rows()).length, 2);
    assert.equal(await page.getByLabel('Soovitud tarnepäev').inputValue(), '2030-03-07');
  });

  await step('the confirmed order is stored with its number and sums', async () => {
    const net = cents(await visitor.value('Ilma käibemaksuta'));
    const gross = cents(await visitor.value('Tasuda'));
    await visitor.press('Kinnita tellimus');
    assert.match(await page.getByRole('status').innerText(), /tellimus on vastu võetud/);
    const heading = await visitor.heading();
    number = heading.replace('Tellimus ', '');
    assert.match(number, /\d/);
    const rows = await visitor.rows();
    assert.deepEqual(
      rows.map((row) => [row.code, row.Kogus]),
      [
        [chosen[0].code, '5'],
        [chosen[1].code, '3'],
      ],
    );
    assert.equal(cents(rows[0].Summa), 5 * cents(chosen[0].own));
    assert.ok(rows[1].name.includes('<i>lõigata</i> 1,2 m'));
    assert.equal(total(rows.map((row) => row.Summa)), net);
    assert.equal(cents(await visitor.value('Ilma käibemaksuta')), net);
    assert.equal(cents(await visitor.value('Tasuda')), gross);
    const lines = page.locator('dl > div', { hasText: /^Käibemaks/ });
    const taxes = await lines.locator('dd').allInnerTexts();
    assert.equal(net + total(taxes), gross);
    assert.equal(await visitor.value('Soovitud tarnepäev'), '07.03.2030');
    assert.equal(await visitor.value('Märkused'), 'Helistada </textarea> enne');
    await visitor.photograph('tellimus');
  });

  await step('the thanks are said once and the basket is gone', async () => {
    await visitor.arrive(() => page.reload());
    assert.equal(await visitor.heading(), `Tellimus ${number}`);
    assert.equal(await page.getByRole('status').count(), 0);
    await visitor.go('page=Koostamine');
    await page.getByText('Korvis ei ole ühtegi rida').waitFor();
  });

  await step('an order that nobody has begun is changed and keeps its number', async () => {
    await visitor.go('page=Tellimus');
    await visitor.link('Muuda');
    await page.getByLabel('Märkused müüjale').fill('Tuleme ise järele');
    await visitor.press('Kinnita tellimus');
    assert.equal(await visitor.heading(), `Tellimus ${number}`);
    assert.equal(await visitor.value('Märkused'), 'Tuleme ise järele');
    assert.equal((await visitor.rows()).length, 2);
  });

  await step('an order is ordered again and dropped', async () => {
    await visitor.go('page=Tellimus');
    await visitor.link('Telli uuesti');
    assert.equal(await visitor.heading(), 'Tellimuse kinnitamine');
    assert.deepEqual(
      (await visitor.rows()).map((row) => [row.code, row.Kogus]),
      [
        [chosen[0].code, '5'],
        [chosen[1].code, '3'],
      ],
    );
    await page.getByText('Kustuta tellimus…').click();
    await visitor.press('Kustuta tellimus');
    assert.equal(await visitor.heading(), 'Kaubad');
    await page.getByText('Korv on tühi').waitFor();
  });

  await step('a single article is added on its own page', async () => {
    await page.setViewportSize({ width: 1366, height: 900 });
    await visitor.link((await visitor.rows())[0].name);
    await visitor.follow(page.getByRole('link', { name: /^Lisa eraldi/ }));
    assert.equal(await visitor.heading(), 'Kauba lisamine');
    await visitor.photograph('lisamine');
    await page.getByLabel('Kogus').fill('4');
    await visitor.press('Lisa korvi');
    assert.match(await page.getByRole('status').innerText(), /Rida on korvis/);
    await visitor.link('Vaata korvi');
    const [row] = await visitor.rows();
    assert.equal(row.code, chosen[0].code);
    assert.equal(cents(row.Summa), 4 * cents(chosen[0].own));
    await visitor.follow(page.getByRole('link', { name: /^Eemalda/ }));
    await page.getByText('Korvis ei ole ühtegi rida').waitFor();
    assert.equal(await page.getByRole('button', { name: 'Vormista' }).count(), 0);
    await page.getByText('Loobu tellimusest…').click();
    await visitor.press('Loobu tellimusest');
    await page.getByText('Korvis ei ole ühtegi rida').waitFor();
  });

  await step('after logging out an old link leads to the log-on page', async () => {
    await visitor.link('Logi välja');
    assert.equal(await visitor.heading(), 'Olete välja loginud');
    await visitor.photograph('logout');
    await visitor.go('page=Kaubainfo');
    assert.equal(await visitor.message(), 'Sessioon katkestatud - sisenege uuesti!');
    assert.equal(await visitor.heading(), 'Sisenemine');
    await visitor.photograph('logon');
  });
});

visit('a guest orders with name and address', async (visitor, step) => {
  const { page } = visitor;
  await visitor.press('Sisene külalisena');
  await page.getByText('Külaline', { exact: true }).waitFor();
  await visitor.openCatalogue();
  await visitor.search('');
  const [article] = await visitor.rows();
  await visitor.order(['1']);
  await visitor.press('Vormista');

  await step('without a name nothing is sent', async () => {
    await page.getByLabel('Märkused müüjale').fill('Külalise märkus');
    await page.getByRole('button', { name: 'Kinnita tellimus' }).click();
    const refused = await page.getByLabel('Nimi').evaluate((box) => box.matches(':invalid:focus'));
    assert.ok(refused);
  });

  await step('the order carries name and address', async () => {
    await page.getByLabel('Nimi').fill('Jüri Õunapuu');
    await page.getByLabel('Nimi').press('Enter');
    await page.getByLabel('Aadress').fill('Pärna 7, Tartu');
    await visitor.press('Kinnita tellimus');
    assert.match(await visitor.heading(), /^Tellimus .*\d/);
    assert.equal(await visitor.value('Tellija'), 'Jüri Õunapuu');
    assert.equal(await visitor.value('Aadress'), 'Pärna 7, Tartu');
    assert.equal(await visitor.value('Märkused'), 'Külalise märkus');
    assert.deepEqual((await visitor.rows()).map((row) => row.code), [article.code]);
  });
});

visit('a company that may not order sees prices only', async (visitor) => {
  await visitor.logOn('blokk', 'blokk-demo');
  await visitor.openCatalogue();
  await visitor.search('');
  await visitor.page.getByText('Tellimine ei ole praegu lubatud').waitFor();
  assert.equal((await visitor.rows()).length, pageLength);
  assert.equal(await visitor.page.locator('input.kogus').count(), 0);
});

visit('wrong passwords block the session', async (visitor) => {
  const attempts = 10;
  await visitor.logOn('mari', 'vale');
  assert.equal(await visitor.message(), 'Vale kasutajanimi või parool!');
  for (let i = 0; i < attempts && !/blokeeritud/.test(await visitor.message()); i++) {
    await visitor.logOn('mari', 'vale');
  }
  const blocked = /^Sessioon blokeeritud, proovige uuesti \d+ minuti pärast!$/;
  assert.match(await visitor.message(), blocked);
  await visitor.logOn('mari', 'mari-demo');
  assert.match(await visitor.message(), blocked);
});

visit('pages that anybody may open show nothing of a customer', async (visitor) => {
  for (const name of ['Raamistik', 'Vasak', 'Kasutaja', 'Lisatud']) {
    await visitor.go(`page=${name}`);
    assert.doesNotMatch(await visitor.page.locator('body').innerText(), /mari|OÜ|€/i);
  }
});
