import assert from 'node:assert/strict';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';
import { DAY, openViewer, PHONE, record, WALK, withOpened } from './viewer-page.mjs';

let browser;
before(async () => { browser = await startBrowser(); });
after(async () => { await browser?.close(); });

describe('The page of a sun study', () => {
    let recording;
    let viewer;
    before(async () => {
        recording = record(DAY);
        viewer = await openViewer(browser, recording.address);
        await viewer.loaded();
    });
    after(async () => {
        await viewer?.close();
        recording?.remove();
    });

    const text = (id) => viewer.page.locator(id).innerText();
    const place = () => viewer.page.locator('#sun-place').evaluate((sun) => [Number(sun.getAttribute('cx')), Number(sun.getAttribute('cy'))]);

    // The pictures are two hours apart, from 4 to 18 o'clock.
    it('shows the place, and its date, time and zone as its slider moves', async () => {
        const slider = viewer.page.locator('#slider');
        assert.equal(await slider.getAttribute('max'), '7');
        await slider.fill('4');
        await viewer.waitFor(4);
        assert.equal(await text('#sun-date'), 'June 21, 2026');
        assert.equal(await text('#sun-time'), '12:00');
        assert.equal(await text('#sun-zone'), 'UTC+1');
        assert.equal(await text('#sun-site'), 'Athens, Greece');
        await slider.press('ArrowRight');
        await viewer.waitFor(5);
        assert.equal(await text('#sun-time'), '14:00');
    });

    // At the solstice (declination 23.4), in Athens (38.0 north, 23.7 east): the sun rises in the
    // north-east, sets in the north-west and crosses the south at 11:27 of UTC+1. At 12:00 it is
    // 8.2 degrees farther: sin(altitude) = sin 38 sin 23.4 + cos 38 cos 23.4 cos 8.2, 74 degrees;
    // tan(azimuth - 180) = sin 8.2 / (cos 8.2 sin 38 - tan 23.4 cos 38), 28. North is up in the dial.
    it('has the sun in its dial where it stands', async () => {
        const slider = viewer.page.locator('#slider');
        await slider.fill('1');
        await viewer.waitFor(1);
        const [east, north] = await place();
        assert.ok(east > 25 && north < -5, `at 6: ${east}, ${north}`);
        await slider.fill('4');
        await viewer.waitFor(4);
        const [x, y] = await place();
        assert.ok(x < 0 && x > -10 && y > 4 && y < 12, `at 12: ${x}, ${y}`);
        assert.match(await text('#sun-angles'), /Azimuth 20[789]°\n7[34]° above the horizon/);
        await slider.fill('7');
        await viewer.waitFor(7);
        const [west] = await place();
        assert.ok(west < -25, `at 18: ${west}`);
    });

    it('says on its dial when the sun is down', async () => {
        await viewer.page.locator('#slider').fill('0');
        await viewer.waitFor(0);
        assert.match(await text('#sun-angles'), /° below the horizon/);
        assert.equal(await viewer.page.locator('#sun.night').count(), 1);
    });

    it('tells those who hear it what the others see', async () => {
        await viewer.page.locator('#slider').fill('4');
        await viewer.waitFor(4);
        const tree = await viewer.page.locator('body').ariaSnapshot();
        assert.match(tree, /heading "Plate" \[level=1\]/);
        assert.match(tree, /slider "Date and time"/);
        assert.match(tree, /button "Play"/);
        assert.match(tree, /button "Repeat" \[pressed\]/);
        assert.match(tree, /combobox "Speed"/);
        assert.match(tree, /img "Sun: Azimuth 20[789]°, 7[34]° above the horizon"/);
        assert.equal(await viewer.page.locator('#slider').getAttribute('aria-valuetext'), 'June 21, 2026, 12:00 UTC+1');
    });

    it('can be reached and used by the keyboard alone, with a focus that is seen', async () => {
        await viewer.page.mouse.click(5, 300);
        const reached = [];
        for (let i = 0; i < 6; ++i) {
            await viewer.page.keyboard.press('Tab');
            reached.push(await viewer.page.evaluate(() => document.activeElement.id));
        }
        assert.deepEqual(reached.slice(0, 5), ['play', 'slider', 'loop', 'rate', 'more']);
        await viewer.page.locator('#more').focus();
        await viewer.page.keyboard.press('Shift+Tab');
        assert.notEqual(await viewer.page.locator('#rate').evaluate((one) => getComputedStyle(one).outlineStyle), 'none');
        await viewer.page.locator('#more').focus();
        await viewer.page.keyboard.press('Enter');
        await viewer.page.locator('#sheet').waitFor();
        await viewer.page.keyboard.press('Escape');
        await viewer.page.locator('#sheet').waitFor({ state: 'hidden' });
    });

    it('prints its first picture, title and caption, and no controls', async () => {
        await viewer.page.locator('#slider').fill('4');
        await viewer.waitFor(4);
        await viewer.page.evaluate(() => dispatchEvent(new Event('beforeprint')));
        assert.equal(await text('#sun-time'), '04:00');
        await viewer.page.emulateMedia({ media: 'print' });
        for (const id of ['#first', 'h1', '#sun-time']) assert.equal(await viewer.page.locator(id).isVisible(), true, id);
        for (const id of ['#controls', '#picture']) assert.equal(await viewer.page.locator(id).isVisible(), false, id);
        await viewer.page.emulateMedia({ media: 'screen' });
        await viewer.page.evaluate(() => dispatchEvent(new Event('afterprint')));
        assert.equal(await text('#sun-time'), '12:00');
    });

    it('has all of it on a phone, upright and lying', async () => {
        const { width, height } = PHONE.viewport;
        for (const viewport of [{ width, height }, { width: height, height: width }]) {
            await withOpened(browser, recording.address, { ...PHONE, viewport }, async (phone) => {
                await phone.loaded();
                const boxes = {};
                for (const id of ['h1', '#sun', '#controls', '#slider', '#play', '#rate', '#more'])
                    boxes[id] = await phone.page.locator(id).boundingBox();
                for (const [id, box] of Object.entries(boxes))
                    assert.ok(box.x >= 0 && box.y >= 0 && box.x + box.width <= viewport.width && box.y + box.height <= viewport.height, id);
                for (const id of ['#play', '#more'])
                    assert.ok(boxes[id].width >= 40 && boxes[id].height >= 40, `${id} is large enough for a finger`);
                assert.ok(apart(boxes.h1, boxes['#sun']) && apart(boxes['#sun'], boxes['#controls']));
            });
        }
    });
});

// Whether two boxes do not overlap.
function apart(a, b) {
    return a.x + a.width <= b.x || b.x + b.width <= a.x || a.y + a.height <= b.y || b.y + b.height <= a.y;
}

describe('The page of a walk', () => {
    it('has a slider that runs through it', async () => {
        const recording = record(WALK);
        await withOpened(browser, recording.address, {}, async (viewer) => {
            await viewer.loaded();
            const slider = viewer.page.locator('#slider');
            await slider.fill('9');
            await viewer.waitFor(9);
            assert.equal(await slider.getAttribute('aria-valuetext'), 'Picture 10 of 10');
            await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(8);
            assert.deepEqual(viewer.mistakes, []);
        });
        recording.remove();
    });
});
