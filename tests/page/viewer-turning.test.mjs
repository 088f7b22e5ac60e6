import assert from 'node:assert/strict';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';
import { fingers, openViewer, PHONE, record, redPlace, TURNTABLE } from './viewer-page.mjs';

const FRAMES = 24;

const pause = (ms) => new Promise((resolve) => setTimeout(resolve, ms));

// Which way a turn goes, in frames from -12 to 12.
const way = (from, to) => ((to - from + FRAMES / 2) % FRAMES + FRAMES) % FRAMES - FRAMES / 2;

// Presses, moves in small steps, rests so that nothing is thrown, and lets go.
async function drag(viewer, across, down = 0) {
    const { x, y } = viewer.middle;
    await viewer.page.mouse.move(x, y);
    await viewer.page.mouse.down();
    await viewer.page.mouse.move(x + across, y + down, { steps: 6 });
    await pause(150);
    await viewer.page.mouse.up();
}

let browser;
before(async () => { browser = await startBrowser(); });
after(async () => { await browser?.close(); });

for (const direction of ['clockwise', 'anticlockwise']) {
    describe(`The page of a turntable that goes ${direction}`, () => {
        let recording;
        let viewer;
        before(async () => {
            recording = record([...TURNTABLE, '--direction', direction], { extra: ['--one-file'] });
            viewer = await openViewer(browser, recording.address);
            await viewer.loaded();
        });
        after(async () => {
            await viewer?.close();
            recording?.remove();
        });

        it('moves the near side of the model with the hand', async () => {
            const middle = await redPlace(viewer);
            assert.ok(middle > 0.4 && middle < 0.6, `the post begins in the middle, not at ${middle}`);
            await drag(viewer, viewer.pictureWidth / 12);
            const right = await redPlace(viewer);
            assert.ok(right > middle + 0.03, `it went from ${middle} to ${right}`);
            await drag(viewer, -viewer.pictureWidth / 6);
            const left = await redPlace(viewer);
            assert.ok(left < middle - 0.03, `it went from ${middle} to ${left}`);
        });

        it('turns by the right arrow as by a hand that goes to the right', async () => {
            await viewer.page.keyboard.press('Home');
            await viewer.waitFor(0);
            await viewer.page.keyboard.press('ArrowRight');
            const after = await viewer.wanted();
            assert.equal(after, direction === 'clockwise' ? FRAMES - 1 : 1);
            await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(0);
        });
    });
}

describe('The page of a turntable', () => {
    let recording;
    before(() => { recording = record(TURNTABLE, { extra: ['--one-file'] }); });
    after(() => { recording?.remove(); });

    async function withViewer(options, use) {
        const viewer = await openViewer(browser, recording.address, options);
        try {
            await viewer.loaded();
            await use(viewer);
            assert.deepEqual(viewer.mistakes, []);
        } finally {
            await viewer.close();
        }
    }

    it('turns once by a drag across the picture, and half by half', () => withViewer({}, async (viewer) => {
        const start = await viewer.wanted();
        await drag(viewer, viewer.pictureWidth / 2 - 2);
        assert.equal(Math.abs(way(start, await viewer.wanted())), FRAMES / 2);
        await drag(viewer, viewer.pictureWidth / 2 - 2);
        assert.equal(way(start, await viewer.wanted()), 0);
        await drag(viewer, viewer.pictureWidth / 4);
        assert.equal(Math.abs(way(start, await viewer.wanted())), FRAMES / 4);
    }));

    it('runs on when it is thrown, and comes to rest', () => withViewer({ reducedMotion: 'no-preference' }, async (viewer) => {
        await viewer.page.mouse.click(viewer.middle.x, viewer.middle.y);
        const { x, y } = viewer.middle;
        await viewer.page.mouse.move(x - 100, y);
        await viewer.page.mouse.down();
        await viewer.page.mouse.move(x + 60, y, { steps: 4 });
        const released = await viewer.wanted();
        await viewer.page.mouse.up();
        await pause(250);
        const running = await viewer.wanted();
        assert.ok(way(released, running) < 0, `it goes on as it went: ${released} to ${running}`);
        await pause(2200);
        const rest = await viewer.wanted();
        await pause(400);
        assert.equal(await viewer.wanted(), rest);
        assert.notEqual(rest, released);
    }));

    it('stands where it is let go when motion is to be reduced', () => withViewer({}, async (viewer) => {
        const { x, y } = viewer.middle;
        await viewer.page.mouse.move(x, y);
        await viewer.page.mouse.down();
        await viewer.page.mouse.move(x + 150, y, { steps: 3 });
        await viewer.page.mouse.up();
        const released = await viewer.wanted();
        await pause(300);
        assert.equal(await viewer.wanted(), released);
    }));

    it('turns by itself once loaded, but not when motion is to be reduced', async () => {
        await withViewer({ reducedMotion: 'no-preference' }, async (viewer) => {
            await viewer.page.waitForFunction(() => Number(document.getElementById('stage').dataset.frame) > 2, null, { timeout: 4000 });
            await viewer.page.keyboard.press(' ');
            const held = await viewer.wanted();
            await pause(400);
            assert.equal(await viewer.wanted(), held);
        });
        await withViewer({}, async (viewer) => {
            await pause(500);
            assert.equal(await viewer.wanted(), 0);
        });
    });

    it('goes to the ends by Home and End, and plays by the space bar at the chosen rate', () => withViewer({}, async (viewer) => {
        await viewer.page.keyboard.press('End');
        await viewer.waitFor(FRAMES - 1);
        await viewer.page.keyboard.press('Home');
        await viewer.waitFor(0);
        await viewer.page.locator('#rate').selectOption('5');
        await viewer.page.locator('#stage').focus();
        const start = Date.now();
        await viewer.page.keyboard.press(' ');
        await viewer.page.waitForFunction(() => Number(document.getElementById('stage').dataset.frame) >= 5);
        const seconds = (Date.now() - start) / 1000;
        assert.ok(seconds > 0.7 && seconds < 1.8, `5 pictures at 5 a second took ${seconds} s`);
    }));

    it('plays one turn where it is not to repeat', () => withViewer({}, async (viewer) => {
        await viewer.page.locator('#rate').selectOption('60');
        await viewer.page.locator('#loop').click();
        await viewer.page.locator('#play').click();
        await viewer.page.waitForFunction(() => document.getElementById('stage').dataset.frame === '23');
        await pause(200);
        assert.equal(await viewer.wanted(), FRAMES - 1);
        assert.equal(await viewer.page.locator('#play').getAttribute('aria-label'), 'Play');
    }));

    it('grows under the wheel about the mouse, turns from near, and fits by a double click', () => withViewer({}, async (viewer) => {
        const before = await redPlace(viewer);
        const x = before * 960;
        await viewer.page.mouse.move(x, viewer.middle.y);
        for (let i = 0; i < 4; ++i) await viewer.page.mouse.wheel(0, -200);
        await viewer.page.locator('#fit').waitFor();
        await pause(250);
        assert.ok(Math.abs(await redPlace(viewer) - before) < 0.03, 'what lies under the mouse stays there');
        await drag(viewer, 80);
        assert.notEqual(await viewer.wanted(), 0);
        await viewer.page.mouse.dblclick(viewer.middle.x, viewer.middle.y);
        await viewer.page.locator('#fit').waitFor({ state: 'hidden' });
    }));

    it('fills the screen by F and by its button, and leaves it again', () => withViewer({}, async (viewer) => {
        const isFull = () => viewer.page.evaluate(() => document.fullscreenElement !== null);
        await viewer.page.keyboard.press('f');
        await viewer.page.waitForFunction(() => document.fullscreenElement !== null);
        await viewer.page.locator('#full').click();
        await viewer.page.waitForFunction(() => document.fullscreenElement === null);
        assert.equal(await isFull(), false);
    }));

    it('turns under a finger, grows between two, and fits by a double tap', () => withViewer(PHONE, async (viewer) => {
        const touch = await fingers(viewer);
        const { x, y } = viewer.middle;
        await touch('touchStart', [x, y]);
        for (let step = 1; step <= 5; ++step) await touch('touchMove', [x + step * 390 / 20, y]);
        await pause(150);
        await touch('touchEnd');
        assert.equal(Math.abs(way(0, await viewer.wanted())), FRAMES / 4);
        await touch('touchStart', [x - 30, y], [x + 30, y]);
        for (let step = 1; step <= 5; ++step) await touch('touchMove', [x - 30 - 12 * step, y], [x + 30 + 12 * step, y]);
        await touch('touchEnd');
        await viewer.page.locator('#fit').waitFor();
        for (let tap = 0; tap < 2; ++tap) {
            await touch('touchStart', [x, y]);
            await touch('touchEnd');
        }
        await viewer.page.locator('#fit').waitFor({ state: 'hidden' });
    }));

    it('lets its controls fade and come back', () => withViewer({}, async (viewer) => {
        const opacity = () => viewer.page.locator('#controls').evaluate((bar) => getComputedStyle(bar).opacity);
        await drag(viewer, 40);
        await viewer.page.locator('#viewer.idle').waitFor({ timeout: 4000 });
        await viewer.page.waitForFunction(() => getComputedStyle(document.getElementById('controls')).opacity === '0');
        await viewer.page.mouse.move(500, 300);
        await viewer.page.waitForFunction(() => getComputedStyle(document.getElementById('controls')).opacity === '1');
        assert.equal(await opacity(), '1');
    }));
});
