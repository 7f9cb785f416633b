// The web review in a real browser: starts `qelhost serve` on a free port with settings of
// its own, drives the page in headless chromium and checks what a person would see.
//   node review.test.mjs QELHOST [MODEL_GENERATOR] [OUTPUT_DIR]
// MODEL_GENERATOR (measure_model_load) makes a 10k-annotation model for the click timing,
// which is printed, never asserted. The screenshot goes to OUTPUT_DIR/web-review.png.
import { spawn, execFileSync } from 'node:child_process';
import { existsSync, mkdtempSync, rmSync } from 'node:fs';
import { tmpdir } from 'node:os';
import path from 'node:path';

let chromium;
try {
  ({ chromium } = await import('playwright-core'));
} catch {
  console.error('web review: playwright-core is not installed in tests/web: run tools/setup.sh');
  process.exit(1);
}

const [qelhost, generator, outputDir = process.cwd()] = process.argv.slice(2);
const chromiumPath = '/usr/bin/chromium';
const scratch = mkdtempSync(path.join(tmpdir(), 'qel-web-review-'));
const servers = [];
const pageErrors = [];
let context = null;

function fail(message) {
  throw new Error(message);
}

// One named check; a failure says which step broke and why.
async function step(name, body) {
  try {
    await body();
    console.log(`ok - ${name}`);
  } catch (error) {
    error.message = `step "${name}" failed: ${error.message}`;
    if (pageErrors.length) error.message += `\nthe page's script failed: ${pageErrors.join('; ')}`;
    throw error;
  }
}

// Starts qelhost serve and resolves with its address once it has printed it.
function startServer(label, extraArgs = []) {
  const settings = path.join(scratch, `${label}-settings`);
  const child = spawn(qelhost, ['serve', '--port', '0', ...extraArgs], {
    env: { ...process.env, QEL_SETTINGS_DIR: settings, QEL_LOG_FILE: path.join(scratch, `${label}.log`) },
    stdio: ['ignore', 'pipe', 'pipe'],
  });
  const server = { child, stdout: '', stderr: '', exited: null };
  servers.push(server);
  child.stdout.setEncoding('utf8').on('data', (text) => { server.stdout += text; });
  child.stderr.setEncoding('utf8').on('data', (text) => { server.stderr += text; });
  server.exit = new Promise((resolve) => child.on('exit', (code, signal) => {
    server.exited = { code, signal };
    resolve(server.exited);
  }));
  return new Promise((resolve, reject) => {
    const timer = setTimeout(() => reject(new Error(`qelhost serve printed no address in 60 s:\n${server.stdout}${server.stderr}`)), 60000);
    const look = () => {
      const found = server.stdout.match(/http:\/\/127\.0\.0\.1:\d+\/\?token=[0-9a-f]+/);
      if (found) {
        clearTimeout(timer);
        server.url = found[0];
        resolve(server);
      }
    };
    child.stdout.on('data', look);
    server.exit.then(({ code, signal }) => {
      clearTimeout(timer);
      reject(new Error(`qelhost serve ended (code ${code}, signal ${signal}) before printing its address:\n${server.stdout}${server.stderr}`));
    });
  });
}

// SIGINT must end the server cleanly: exit 0 after saying it stopped.
async function stopServer(server) {
  if (server.exited) fail(`qelhost ended early (code ${server.exited.code}):\n${server.stderr}`);
  server.child.kill('SIGINT');
  const timeout = new Promise((resolve) => setTimeout(() => resolve(null), 15000));
  const ended = await Promise.race([server.exit, timeout]);
  if (!ended) {
    server.child.kill('SIGKILL');
    fail('qelhost did not stop within 15 s of SIGINT');
  }
  if (ended.code !== 0) fail(`qelhost ended with code ${ended.code} (signal ${ended.signal}) on SIGINT:\n${server.stderr}`);
  if (!server.stdout.includes('qelhost: stopped')) fail(`qelhost did not say it stopped:\n${server.stdout}`);
}

async function openBrowser(profile) {
  if (!existsSync(chromiumPath)) fail(`${chromiumPath} is missing: run tools/setup.sh`);
  return chromium.launchPersistentContext(path.join(scratch, profile), {
    executablePath: chromiumPath,
    headless: true,
    viewport: { width: 1280, height: 800 },
    args: ['--headless', '--no-sandbox', '--disable-gpu', '--disable-quic', '--no-first-run',
      '--disable-background-networking', '--disable-component-update', '--disable-sync'],
  });
}

// The number of States the page has applied; each answered POST adds one.
const serial = (page) => page.evaluate(() => Number(document.body.dataset.serial || 0));

// Runs an action and waits until the page has applied its answer and shown the picture.
async function settled(page, action) {
  const before = await serial(page);
  await action();
  await page.waitForFunction((n) => Number(document.body.dataset.serial || 0) > n
    && document.body.getAttribute('aria-busy') !== 'true' && document.body.dataset.picture === 'ready', before,
  { timeout: 20000 });
}

const pageState = (page) => page.evaluate(() => ({
  counts: document.getElementById('display-summary').textContent,
  changes: document.getElementById('changes').textContent,
  picture: document.getElementById('picture').getAttribute('src'),
  panel: document.getElementById('panel').innerHTML,
}));

// The row whose caption is `text` or ends in "/text" (a set's caption carries its product's
// path), and its check box or radio.
const escape = (text) => text.replace(/[.*+?^${}()|[\]\\]/g, '\\$&');
const rowNamed = (page, scope, text) => scope.locator('.row').filter({
  has: page.locator('label.caption', { hasText: new RegExp(`(^|/)${escape(text)}$`) }),
});
const rowInput = (page, text) => rowNamed(page, page.locator('#panel'), text)
  .locator('input[type=checkbox], input[type=radio]').first();

async function expandRow(page, text) {
  const head = page.locator('#panel .expander-head').filter({ has: rowNamed(page, page, text) });
  const toggle = head.locator('.toggle').first();
  if (await toggle.getAttribute('aria-expanded') === 'false') await settled(page, () => toggle.click());
}

async function reviewSample(page, url) {
  page.on('pageerror', (error) => pageErrors.push(error.message));

  await step('the page loads with the panel and a picture', async () => {
    await page.goto(url);
    await page.waitForFunction(() => document.body.dataset.picture === 'ready', null, { timeout: 20000 });
    const sections = await page.locator('#panel .section-heading').allTextContents();
    if (sections.length < 2) fail(`expected the panel's sections, found ${JSON.stringify(sections)}`);
    const size = await page.locator('#picture').evaluate((img) => [img.naturalWidth, img.naturalHeight]);
    if (size[0] < 64 || size[1] < 64) fail(`the picture is ${size.join(' x ')}`);
    if (!/\d+ shown · \d+ hidden/.test(await page.locator('#display-summary').textContent())) fail('no display counts');
    if (await page.locator('#browser button.item').count() === 0) fail('the views browser lists nothing');
  });

  await step('unticking a set hides its annotations', async () => {
    await expandRow(page, 'Selected sets');
    const box = rowInput(page, 'Shaft Inspection');
    if (!(await box.isChecked())) fail('the set "Shaft Inspection" starts unticked');
    const before = await pageState(page);
    // One download of the new picture: the element that loaded it is the one shown.
    const pictures = [];
    const count = (request) => { if (request.url().includes('/api/picture.png')) pictures.push(request.url()); };
    page.on('request', count);
    await settled(page, () => box.click());
    page.off('request', count);
    if (pictures.length !== 1) fail(`the picture was asked for ${pictures.length} times: ${pictures.join(', ')}`);
    const after = await pageState(page);
    if (await rowInput(page, 'Shaft Inspection').isChecked()) fail('the row is still ticked');
    if (!after.changes.startsWith('Hidden:')) fail(`the changes read "${after.changes}"`);
    if (after.counts === before.counts) fail(`the counts stayed "${after.counts}"`);
    if (after.picture === before.picture) fail('the picture address did not change');
  });

  await step('the ".All" question appears and "No" leaves everything as it was', async () => {
    const before = await pageState(page);
    await rowInput(page, 'All sets').click();
    const dialog = page.locator('dialog#question');
    await dialog.waitFor({ state: 'visible', timeout: 10000 });
    if (!(await page.locator('#question-title').textContent()).trim()) fail('the question has no title');
    if (!(await page.locator('#question-message').textContent()).trim()) fail('the question has no message');
    await settled(page, () => page.locator('#answer-no').click());
    if (await dialog.isVisible()) fail('the question is still open');
    const after = await pageState(page);
    if (after.panel !== before.panel) fail('the panel changed');
    if (after.counts !== before.counts) fail(`the counts went from "${before.counts}" to "${after.counts}"`);
    if (after.picture !== before.picture) fail('the picture changed');
  });

  await step('choosing a capture changes the picture', async () => {
    // A capture with an associated view: one without has no viewpoint to apply.
    const capture = page.locator('#browser button.item.capture').filter({ has: page.locator('.item-description') }).first();
    await capture.waitFor();
    const before = await page.locator('#picture').screenshot();
    const address = await page.locator('#picture').getAttribute('src');
    await settled(page, () => capture.click());
    if (await page.locator('#picture').getAttribute('src') === address) fail('the picture address did not change');
    if ((await page.locator('#picture').screenshot()).equals(before)) fail('the picture looks the same');
    if (await capture.getAttribute('aria-pressed') !== 'true') fail('the capture is not marked as chosen');
  });

  await step('the capture shows exactly its view, and the rows and the hidden list follow', async () => {
    const hidden = await page.locator('#not-drawn').textContent();
    if (!hidden.includes('Fillet Weld 5')) fail(`another set's weld is still drawn: "${hidden}"`);
    if (hidden.includes('Datum A:')) fail(`a datum of the capture's view is not drawn: "${hidden}"`);
    await expandRow(page, 'By kind');
    await expandRow(page, 'Welds');
    if (await rowInput(page, 'Fillet Weld 5').isChecked()) fail('the weld\'s row still reads ticked');
    const title = await rowNamed(page, page.locator('#panel'), 'Fillet Weld 5').getAttribute('title');
    if (!title || !title.includes('Fillet Weld 5')) fail(`hovering the hidden weld's row says "${title}"`);
  });

  await step('a range that cannot apply is marked at its box and never applied', async () => {
    const row = page.locator('#panel .row').filter({ has: page.locator('input.editor') }).first();
    const [low, high] = [row.locator('input.editor').nth(0), row.locator('input.editor').nth(1)];
    const before = await pageState(page);
    await low.fill('abc');
    await low.press('Enter');
    await page.locator('#panel .box-error').first().waitFor({ timeout: 10000 });
    if (!(await page.locator('#panel .box-error').first().textContent()).includes('not a number')) fail('no reason at the box');
    if (await low.getAttribute('aria-invalid') !== 'true') fail('the box is not marked');
    await settled(page, async () => { await low.fill('0.3'); await low.press('Enter'); });
    const lowOp = row.locator('select').nth(0);
    const index = await lowOp.evaluate((s) => [...s.options].findIndex((o) => o.text === '<='));
    await settled(page, () => lowOp.selectOption({ index }));
    await settled(page, async () => { await high.fill('0.1'); await high.press('Enter'); });
    await row.locator(':scope > input[type=checkbox]').click();
    await page.locator('#panel .box-error').first().waitFor({ timeout: 10000 });
    const reason = await page.locator('#panel .box-error').first().textContent();
    if (!reason.includes('upper bound 0.1 is below the lower bound 0.3')) fail(`the reason reads "${reason}"`);
    if (await row.locator(':scope > input[type=checkbox]').isChecked()) fail('the range row got ticked');
    if ((await pageState(page)).counts !== before.counts) fail('the display changed');
  });

  await step('the range row applies a tolerance range', async () => {
    const row = page.locator('#panel .row').filter({ has: page.locator('input.editor') }).first();
    const [lowOp, highOp] = [row.locator('select').nth(0), row.locator('select').nth(1)];
    const [low, high] = [row.locator('input.editor').nth(0), row.locator('input.editor').nth(1)];
    const pick = async (select, text) => {
      const index = await select.evaluate((s, t) => [...s.options].findIndex((o) => o.text === t), text);
      if (index < 0) fail(`the operator "${text}" is not offered`);
      await settled(page, () => select.selectOption({ index }));
    };
    const enter = async (editor, text) => {
      await editor.fill(text);
      await settled(page, () => editor.press('Enter'));
    };
    await pick(lowOp, '<=');
    await enter(low, '0.05');
    await pick(highOp, '<');
    await enter(high, '0.2');
    const before = await pageState(page);
    const tick = row.locator(':scope > input[type=checkbox]');
    if (await tick.isChecked()) await settled(page, () => row.locator('button').click());
    else await settled(page, () => tick.click());
    const after = await pageState(page);
    if (!(await tick.isChecked())) fail('the range row is not ticked');
    if (await low.inputValue() !== '0.05' || await high.inputValue() !== '0.2') {
      fail(`the range reads ${await low.inputValue()} .. ${await high.inputValue()}`);
    }
    if (!after.changes.includes('Hidden:')) fail(`the changes read "${after.changes}"`);
    if (after.counts === before.counts) fail(`the counts stayed "${after.counts}"`);
  });

  await step('the filters in effect read above the panel, each undone by its button', async () => {
    const parts = await page.locator('#filters .filter').allTextContents();
    const range = parts.find((text) => text.includes('0.05 <= t < 0.2'));
    if (!range) fail(`the range is not among the filters: ${JSON.stringify(parts)}`);
    await settled(page, () => page.locator('#filters button.filter', { hasText: '0.05 <= t < 0.2' }).click());
    if ((await page.locator('#filters').textContent()).includes('0.05 <= t < 0.2')) fail('the range still filters');
    await settled(page, () => page.locator('#reset').click());
    const after = await page.locator('#filters').textContent();
    if (after.includes('Shaft Inspection')) fail(`reset left the set unticked: "${after}"`);
    if (!(await rowInput(page, 'Shaft Inspection').isChecked())) fail('reset left the set\'s row unticked');
  });

  await step('a product of the tree brings its own captures into the browser', async () => {
    await settled(page, () => page.locator('#products button', { hasText: /^Bracket$/ }).click());
    const names = await page.locator('#browser .item-name').allTextContents();
    if (!names.includes('Weld Review')) fail(`the browser lists ${JSON.stringify(names)}`);
    await settled(page, () => page.locator('#products button', { hasText: 'Bracket Assembly' }).click());
  });

  await step('Close asks first, and the page offers the panel again', async () => {
    const close = page.locator('#panel button', { hasText: 'Close' }).first();
    await close.click();
    await page.locator('dialog#close-question').waitFor({ state: 'visible', timeout: 10000 });
    await page.locator('#close-no').click();
    if (await page.locator('#open-panel').count() !== 0) fail('"Keep it" closed the panel');
    await close.click();
    await settled(page, () => page.locator('#close-yes').click());
    await page.locator('#open-panel').waitFor({ timeout: 10000 });
    await settled(page, () => page.locator('#open-panel').click());
    if (await page.locator('#panel .section-heading').count() < 2) fail('the panel did not come back');
  });

  await step('labels that find no room keep their mark and are named under the picture', async () => {
    // A picture too small for the labels, then any change: the answer names those left out.
    await page.evaluate(() => fetch('/api/picture.png?w=64&h=64', { cache: 'no-store' }).then((r) => r.blob()));
    await settled(page, () => page.locator('#zoom-in').click());
    const said = await page.locator('#unplaced').textContent();
    if (!/^\d+ label\(s\) not placed, marks only: \S/.test(said)) fail(`under the picture: "${said}"`);
    await settled(page, () => page.locator('#zoom-out').click());
  });

  await step('Reframe brings the whole product back into the picture', async () => {
    const address = await page.locator('#picture').getAttribute('src');
    await settled(page, () => page.getByRole('button', { name: 'Reframe' }).click());
    if (await page.locator('#picture').getAttribute('src') === address) fail('the picture address did not change');
  });

  await step('a screenshot is saved', async () => {
    await page.mouse.move(0, 0);
    await page.waitForFunction(() => [...document.querySelectorAll('#browser img')]
      .every((img) => img.complete), null, { timeout: 30000 });
    const file = path.join(outputDir, 'web-review.png');
    await page.screenshot({ path: file });
    console.log(`screenshot: ${file}`);
  });

  if (pageErrors.length) fail(`the page's script failed: ${pageErrors.join('; ')}`);
}

// Click to updated panel and picture, at 10k annotations: a figure for the notes, never a
// check, so a slow or failed measurement is reported and does not fail the test.
async function measureLargeModel() {
  const model = path.join(scratch, 'model-10k.json');
  execFileSync(generator, ['generate', '10000', model], { stdio: 'ignore', timeout: 60000 });
  const server = await startServer('large', [model]);
  // A profile of its own: the first server's cookie would otherwise be sent to this one.
  const large = await openBrowser('large-profile');
  const page = await large.newPage();
  try {
    const start = Date.now();
    await page.goto(server.url);
    await page.waitForFunction(() => document.body.dataset.picture === 'ready', null, { timeout: 60000 });
    const loaded = Date.now() - start;
    const click = (radio) => rowInput(page, radio).getAttribute('data-wid').then((id) => page.evaluate(async (wid) => {
      const before = Number(document.body.dataset.serial);
      const clicked = performance.now();
      document.querySelector(`#panel [data-wid="${wid}"]`).click();
      await new Promise((resolve, reject) => {
        setTimeout(() => reject(new Error('no answer within 60 s')), 60000);
        const observer = new MutationObserver(() => {
          if (Number(document.body.dataset.serial) > before && document.body.dataset.picture === 'ready') {
            observer.disconnect();
            requestAnimationFrame(() => resolve());
          }
        });
        observer.observe(document.body, { attributes: true });
      });
      return performance.now() - clicked;
    }, id));
    // The first clicks after loading, then a reviewer going on: the same two clicks again,
    // once the server's memory has settled.
    const first = [];
    for (const radio of ['No set', 'Selected sets', 'No set']) first.push(await click(radio));
    const later = { 'No set': [], 'Selected sets': [] };
    for (let round = 0; round < 5; ++round) {
      for (const radio of ['Selected sets', 'No set']) later[radio].push(await click(radio));
    }
    const median = (values) => [...values].sort((a, b) => a - b)[Math.floor(values.length / 2)];
    const spread = (values) => `median ${median(values).toFixed(0)}, max ${Math.max(...values).toFixed(0)}`;
    console.log(`10k annotations: page loaded in ${loaded} ms; click to updated panel and picture `
      + `${first.map((t) => t.toFixed(0)).join(', ')} ms; then over five more rounds "Selected sets" `
      + `${spread(later['Selected sets'])} ms, "No set" ${spread(later['No set'])} ms`);
  } catch (error) {
    const seen = await page.evaluate(() => `status "${document.getElementById('status').textContent}", `
      + `${document.body.dataset.serial || 0} answer(s) drawn, picture ${document.body.dataset.picture}`).catch(() => '');
    console.log(`10k annotations: not measured: ${error.message.split('\n')[0]} (${seen})`);
  } finally {
    await large.close();
    await stopServer(server);
  }
}

async function main() {
  if (!qelhost || !existsSync(qelhost)) fail(`usage: node review.test.mjs QELHOST [MODEL_GENERATOR] [OUTPUT_DIR]`);
  const server = await startServer('sample');
  context = await openBrowser('profile');
  const page = await context.newPage();
  await reviewSample(page, server.url);
  await page.close();
  await step('SIGINT stops the server cleanly', () => stopServer(server));
  if (generator && existsSync(generator)) await measureLargeModel();
}

try {
  await main();
} catch (error) {
  console.error(`web review: ${error.message}`);
  for (const server of servers) {
    if (server.stderr.trim()) console.error(`qelhost said on stderr:\n${server.stderr.trim()}`);
  }
  process.exitCode = 1;
} finally {
  if (context) await context.close().catch(() => {});
  for (const server of servers) if (!server.exited) server.child.kill('SIGKILL');
  rmSync(scratch, { recursive: true, force: true });
}
