// Pictures of the main pages for people to look at: node pictures.mjs FOLDER
import { mkdirSync } from 'node:fs';
import { Visitor, openBrowser } from './portal.mjs';

const widths = { 390: 844, 820: 1100, 1366: 900 };
const folder = process.argv[2];
const address = process.env.ZEBTELL_URL;

async function take(page, scheme, name) {
  for (const [width, height] of Object.entries(widths)) {
    await page.setViewportSize({ width: Number(width), height });
    await page.screenshot({ path: `${folder}/${name}-${scheme}-${width}.png` });
  }
}

async function visit(browser, scheme) {
  const context = await browser.newContext({ locale: 'et-EE', colorScheme: scheme });
  const page = await context.newPage();
  const visitor = new Visitor(context, page);
  const see = (name) => take(page, scheme, name);
  await page.goto(address);
  await see('logon');
  await visitor.logOn('mari', 'mari-demo');
  await see('start');
  await visitor.openCatalogue();
  await visitor.search('kruvi 8');
  await visitor.order(['4', '', '12', '2']);
  const box = page.locator('input.kogus[name^="ID_"]').nth(4);
  await box.fill('10');
  await see('catalogue');
  await box.fill('');
  await visitor.link((await visitor.rows())[5].name);
  await see('article');
  await visitor.go('page=Koostamine');
  await page.getByLabel('Märkus').first().fill('Kiire, kui võimalik');
  await see('basket');
  await visitor.press('Vormista');
  await page.getByLabel('Märkused müüjale').fill('Helistada enne tulekut');
  await see('confirmation');
  await visitor.press('Kinnita tellimus');
  await see('order');
  for (const [query, name] of [['Kasutaja', 'user'], ['Yld', 'terms'], ['Logout', 'logout']]) {
    await visitor.go(`page=${query}`);
    await see(name);
  }
  await context.close();
}

mkdirSync(folder, { recursive: true });
const browser = await openBrowser();
for (const scheme of ['light', 'dark']) await visit(browser, scheme);
await browser.close();
