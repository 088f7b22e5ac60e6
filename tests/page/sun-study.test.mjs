import assert from 'node:assert/strict';
import { join } from 'node:path';
import { after, afterEach, before, beforeEach, describe, it } from 'node:test';
import { openRecorded, recordDay, screenshotFolder, startBrowser } from './recorded-page.mjs';

// The recording's own page tells the whole hours of the longitude: in Athens UTC+1, in summer two
// hours behind the clocks on the wall.
describe('The page of a sun study', () => {
    let browser;
    let recording;
    let opened;

    before(async () => {
        recording = recordDay({ date: '2026-06-21', from: '13:30', to: '16:00', every: 30,
                                name: 'Sun' });
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

    it('shows the date and the time of the frame in place of its number', async () => {
        assert.equal(await opened.shownFrame(), 1);
        assert.equal(await opened.caption(), '2026-06-21 12:00:00');
        await opened.play(1);
        assert.equal(await opened.shownFrame(), 2);
        assert.equal(await opened.caption(), '2026-06-21 12:30:00');
        await opened.page.screenshot({ path: join(screenshotFolder, 'sun-study.png') });
    });

    it('has a frame at both ends', async () => {
        await opened.toggle.click();
        await opened.first.click();
        assert.equal(await opened.caption(), '2026-06-21 11:30:00');
        await opened.last.click();
        assert.equal(await opened.shownFrame(), 5);
        assert.equal(await opened.caption(), '2026-06-21 14:00:00');
    });

    it('hides and shows the date with the box', async () => {
        await opened.counterBox.uncheck();
        assert.equal(await opened.counter.isVisible(), false);
        await opened.counterBox.check();
        assert.equal(await opened.counter.isVisible(), true);
    });
});
