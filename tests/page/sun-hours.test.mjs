import assert from 'node:assert/strict';
import { spawnSync } from 'node:child_process';
import { mkdtempSync, rmSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { pathToFileURL } from 'node:url';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';

// A floor of 8 by 8, and on its eastern half a table 2 high that shades all below it.
const MODEL = `o Floor
v -4 -4 0
v 4 -4 0
v 4 4 0
v -4 4 0
f 1 2 3 4
o Table
v 1 -3 2
v 3 -3 2
v 3 3 2
v 1 3 2
f 5 6 7 8
`;

describe('The page of hours of sun', () => {
    let browser;
    let folder;
    let page;
    const mistakes = [];
    before(async () => {
        folder = mkdtempSync(join(tmpdir(), 'quarn-hours-'));
        writeFileSync(join(folder, 'yard.obj'), MODEL);
        const run = spawnSync(process.env.QUARN_PROGRAM, ['sunhours', join(folder, 'yard.obj'), '--latitude', '0', '--longitude', '0',
            '--zone', 'UTC', '--date', '2026-03-20', '--every', '60', '--view', 'plan', '--size', '160x160', '--out', folder], { encoding: 'utf8' });
        assert.equal(run.status, 0, run.stderr);
        browser = await startBrowser();
        page = await browser.newPage();
        page.on('pageerror', (error) => mistakes.push(error.message));
        await page.goto(pathToFileURL(join(folder, 'yard-sunhours.html')).href);
    });
    after(async () => {
        await browser?.close();
        rmSync(folder, { recursive: true, force: true });
    });

    const readAt = async (x, y) => {
        const box = await page.locator('#picture').boundingBox();
        await page.mouse.move(box.x + x * box.width, box.y + y * box.height);
        return page.locator('#reading').innerText();
    };

    it('reads hours and object under the pointer', async () => {
        assert.match(await readAt(0.75, 0.5), /^1[12]\.\d h · Table$/);
        assert.match(await readAt(0.2, 0.5), /h · Floor$/);
        assert.doesNotMatch(await readAt(0.001, 0.001), /h ·/); // beside the model
    });

    it('shows the shadows of the time that its slider stands at', async () => {
        const slider = page.locator('#slider');
        const shade = (x, y) => page.locator('#shadow').evaluate((canvas, at) =>
            canvas.getContext('2d').getImageData(Math.floor(at[0] * canvas.width), Math.floor(at[1] * canvas.height), 1, 1).data[3], [x, y]);
        const hours = Number(await slider.getAttribute('max'));
        assert.equal(hours, 11); // 7 to 18 o'clock: the sun is in the south at 12:07
        await slider.fill('0');
        assert.equal(await page.locator('#clock').innerText(), '07:00 UTC');
        assert.equal(await shade(0.75, 0.5), 0);
        await slider.fill('1'); // at 8 the sun is 28 degrees high: 2 / tan 28 = 3.7 lies the shadow in the west
        assert.notEqual(await shade(0.35, 0.5), 0);
        await slider.fill(String(hours));
        assert.equal(await shade(0.35, 0.5), 0);
    });

    it('makes no mistake and asks nobody for anything', () => assert.deepEqual(mistakes, []));
});
