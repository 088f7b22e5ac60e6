import assert from 'node:assert/strict';
import { after, before, describe, it } from 'node:test';
import { openRecorded, recordHostile, startBrowser } from './recorded-page.mjs';

// The document's name would make an element that runs a script, its labels would end the page's one.
describe("The page of somebody else's document", () => {
    let browser;
    let recording;
    let opened;

    before(async () => {
        recording = recordHostile('script_in_names.quarn');
        browser = await startBrowser();
        opened = await openRecorded(browser, recording.address);
    });
    after(async () => {
        await browser?.close();
        recording?.remove();
    });

    it('runs no script of the document', async () => {
        assert.equal(await opened.page.evaluate(() => typeof broken), 'undefined');
        assert.equal(await opened.page.evaluate(() => typeof window.broken), 'undefined');
        assert.deepEqual(opened.mistakes, []);
    });

    it('has no elements but those of every page', async () => {
        assert.equal(await opened.page.locator('img').count(), 1);
        assert.equal(await opened.page.locator('script').count(), 1);
        assert.equal(await opened.page.locator('i').count(), 0);
    });

    it('shows name and labels as texts', async () => {
        const name = "_IMG SRC=x ONERROR=_broken=1__<i> 'A'!!!!!!!!!!";
        assert.equal(await opened.page.title(), name);
        assert.ok((await opened.page.locator('body').innerText()).startsWith(name + '\n'));
        const labels = ['_;window.broken=1;_', '_/SCRIPT__IMG SRC=x', '2026-06-21 07:00:0_',
                        '2026-06-21 07:30_', '2026-06-21 08:00:00'];
        await opened.play(10);
        await opened.first.click();
        for (const label of labels) {
            assert.equal(await opened.caption(), label);
            await opened.next.click();
        }
    });

    it('finds every picture under its cleaned name', async () => {
        const widths = await opened.page.evaluate(
            () => Promise.all(Images.map((image) => image.decode().then(() => image.naturalWidth))));
        assert.deepEqual(widths, Array(5).fill(64));
    });
});
