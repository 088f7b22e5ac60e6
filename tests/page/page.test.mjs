import assert from 'node:assert/strict';
import { join } from 'node:path';
import { after, afterEach, before, beforeEach, describe, it } from 'node:test';
import { FRAME_DELAY_MS, openRecorded, recordNothing, recordTurntable, screenshotFolder,
         startBrowser } from './recorded-page.mjs';

const FRAMES = 6;

describe('The recorded page', () => {
    let browser;
    let recording;
    let opened;

    before(async () => {
        recording = recordTurntable({ frames: FRAMES, name: 'House' });
        browser = await startBrowser();
    });
    after(async () => {
        await browser?.close();
        recording?.remove();
    });
    beforeEach(async () => {
        opened = await openRecorded(browser, recording.address);
    });
    afterEach(async () => {
        assert.deepEqual(opened.mistakes, []);
        await opened.page.close();
    });

    const expectShown = async (frame) => {
        assert.equal(await opened.shownFrame(), frame);
        assert.equal(await opened.caption(), String(frame + 1));
    };
    const stepButtons = () => [opened.first, opened.previous, opened.next, opened.last];
    const expectRunning = async (runs) => {
        assert.equal(await opened.toggle.innerText(), runs ? 'Stop' : 'Start');
        for (const button of stepButtons()) assert.equal(await button.isDisabled(), runs);
    };

    it('has the name of the animation as its title and heading', async () => {
        assert.equal(await opened.page.title(), 'House');
        assert.match(await opened.page.locator('body').innerText(), /^House\n/);
    });

    it('loads every picture', async () => {
        const sizes = await opened.page.evaluate(
            () => Promise.all(Images.map((image) => image.decode().then(
                () => [image.naturalWidth, image.naturalHeight]))));
        assert.deepEqual(sizes, Array(FRAMES).fill([320, 180]));
    });

    it('plays from the start and shows frame 2 first', async () => {
        await expectShown(1);
        await expectRunning(true);
    });

    it('shows the next frame when its time has come and not before', async () => {
        await opened.page.clock.runFor(FRAME_DELAY_MS - 1);
        await expectShown(1);
        await opened.page.clock.runFor(1);
        await expectShown(2);
    });

    it('stops behind the last frame when Loop is off', async () => {
        assert.equal(await opened.loop.isChecked(), false);
        await opened.play(FRAMES - 2);
        await expectShown(FRAMES - 1);
        await expectRunning(true);
        await opened.play(1);
        await expectShown(FRAMES - 1);
        await expectRunning(false);
        await opened.play(10);
        await expectShown(FRAMES - 1);
    });

    it('starts again with frame 2 after it came to its end', async () => {
        await opened.play(FRAMES);
        await opened.toggle.click();
        await expectShown(1);
        await expectRunning(true);
    });

    it('goes on with frame 1 when Loop is on', async () => {
        await opened.loop.check();
        await opened.play(FRAMES - 1);
        await expectShown(0);
        await expectRunning(true);
        await opened.play(FRAMES);
        await expectShown(0);
    });

    it('comes to its end after Loop is switched off', async () => {
        await opened.loop.check();
        await opened.play(FRAMES + 1);
        await opened.loop.uncheck();
        await opened.play(FRAMES);
        await expectShown(FRAMES - 1);
        await expectRunning(false);
    });

    it('stands still after Stop and goes on after Start', async () => {
        await opened.play(1);
        await opened.toggle.click();
        await expectRunning(false);
        await opened.play(10);
        await expectShown(2);
        await opened.toggle.click();
        await expectRunning(true);
        await expectShown(3);
        await opened.play(1);
        await expectShown(4);
    });

    it('steps with the four buttons while it stands still', async () => {
        await opened.toggle.click();
        await opened.last.click();
        await expectShown(FRAMES - 1);
        await opened.previous.click();
        await expectShown(FRAMES - 2);
        await opened.first.click();
        await expectShown(0);
        await opened.next.click();
        await expectShown(1);
        await expectRunning(false);
    });

    it('steps back from the first frame to the last', async () => {
        await opened.toggle.click();
        await opened.first.click();
        await opened.previous.click();
        await expectShown(FRAMES - 1);
    });

    it('steps on from the last frame only when Loop is on', async () => {
        await opened.toggle.click();
        await opened.last.click();
        await opened.next.click();
        await expectShown(FRAMES - 1);
        await opened.last.click();
        await opened.loop.check();
        await opened.next.click();
        await expectShown(0);
    });

    it('leaves the step buttons without effect while it plays', async () => {
        await opened.last.click({ force: true });
        await expectShown(1);
    });

    it('shows the frame counter as long as its box is checked', async () => {
        assert.equal(await opened.counterBox.isChecked(), true);
        assert.equal(await opened.counter.isVisible(), true);
        await opened.counterBox.uncheck();
        assert.equal(await opened.counter.isVisible(), false);
        await opened.play(1);
        assert.equal(await opened.counter.isVisible(), false);
        await opened.counterBox.check();
        assert.equal(await opened.counter.isVisible(), true);
        await expectShown(2);
    });

    it('looks like a picture with its buttons below', async () => {
        await opened.toggle.click();
        const image = await opened.page.locator('#animated_image').boundingBox();
        const toggle = await opened.toggle.boundingBox();
        assert.ok(image.width >= 320 && image.height >= 180);
        assert.ok(toggle.y >= image.y + image.height);
        await opened.page.screenshot({ path: join(screenshotFolder, 'page.png') });
    });
});

describe('The page of an animation of one frame', () => {
    it('ends at once, with nothing to step to', async () => {
        const recording = recordTurntable({ frames: 1, name: 'Still' });
        const browser = await startBrowser();
        try {
            const opened = await openRecorded(browser, recording.address);
            assert.equal(await opened.toggle.innerText(), 'Start');
            await opened.first.click();
            assert.equal(await opened.shownFrame(), 0);
            assert.equal(await opened.caption(), '1');
            assert.deepEqual(opened.mistakes, []);
        } finally {
            await browser.close();
            recording.remove();
        }
    });
});

describe('The page of a recording without pictures', () => {
    it('stands still with nothing to show, whatever is pressed', async () => {
        const recording = recordNothing({ name: 'Nothing' });
        const browser = await startBrowser();
        try {
            const opened = await openRecorded(browser, recording.address);
            assert.equal(await opened.page.title(), 'Nothing');
            assert.equal(await opened.page.evaluate(() => ImageCount), 0);
            for (const loops of [false, true]) {
                await opened.loop.setChecked(loops);
                for (const button of [opened.first, opened.previous, opened.next, opened.last,
                                      opened.toggle]) {
                    await button.click();
                    await opened.play(3);
                    assert.equal(await opened.toggle.innerText(), 'Start');
                    assert.equal(await opened.caption(), '');
                }
            }
            assert.equal(await opened.page.locator('#animated_image').getAttribute('src'), null);
            assert.deepEqual(opened.mistakes, []);
        } finally {
            await browser.close();
            recording.remove();
        }
    });
});

describe('The page of an animation with a name that is not ASCII', () => {
    it('shows the name and finds its pictures', async () => {
        const recording = recordTurntable({ frames: 3, name: 'Häuschen am Fluß 家 & Garten' });
        const browser = await startBrowser();
        try {
            const opened = await openRecorded(browser, recording.address);
            assert.equal(await opened.page.title(), 'Häuschen am Fluß 家 & Garten');
            assert.equal(await opened.page.evaluate(() => document.characterSet), 'UTF-8');
            const widths = await opened.page.evaluate(() => Promise.all(
                Images.map((image) => image.decode().then(() => image.naturalWidth))));
            assert.deepEqual(widths, [320, 320, 320]);
            assert.equal(await opened.shownFrame(), 1);
            assert.deepEqual(opened.mistakes, []);
            await opened.page.screenshot({ path: join(screenshotFolder, 'page-name.png') });
        } finally {
            await browser.close();
            recording.remove();
        }
    });
});
