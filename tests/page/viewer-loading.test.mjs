import assert from 'node:assert/strict';
import { cpSync, linkSync, mkdtempSync, readFileSync, rmSync, statSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { pathToFileURL } from 'node:url';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';
import { record, TURNTABLE, writePage, withOpened, withServed } from './viewer-page.mjs';

const FRAMES = 24;
const picture = (frame) => `Plate${String(frame).padStart(3, '0')}.jpg`;
const pause = (ms) => new Promise((resolve) => setTimeout(resolve, ms));

// A gate that files of the server wait at until it is opened for them.
function gate() {
    const waiting = new Map();
    const open = new Set();
    return {
        pass: (name) => open.has(name) || open.has('all') || name.endsWith('.html')
            ? Promise.resolve() : new Promise((resolve) => waiting.set(name, resolve)),
        open(name) {
            open.add(name);
            for (const [other, resolve] of waiting) if (name === 'all' || other === name) resolve();
        },
    };
}

// Copies a page to where nothing else is.
function alone(page, use) {
    const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
    writeFileSync(join(folder, 'alone.html'), page);
    return use(pathToFileURL(join(folder, 'alone.html')).href)
        .finally(() => rmSync(folder, { recursive: true }));
}

describe('A viewer page in a folder', () => {
    let browser;
    let recording;
    before(async () => {
        recording = record(TURNTABLE);
        browser = await startBrowser();
    });
    after(async () => {
        await browser?.close();
        recording?.remove();
    });

    it('shows the first picture at once, then asks for every 8th, 4th, 2nd and the rest', async () => {
        const slow = gate();
        await withServed(browser, recording, async (viewer) => {
            slow.open(picture(0));
            await viewer.waitFor(0);
            await viewer.page.locator('#ring').waitFor({ state: 'visible' });
            slow.open('all');
            await viewer.loaded();
            assert.equal(await viewer.page.locator('#ring').isVisible(), false);
            const order = [0, 8, 16, 4, 12, 20, 2, 6, 10, 14, 18, 22];
            for (let frame = 1; frame < FRAMES; frame += 2) order.push(frame);
            const asked = viewer.requests.map((url) => url.split('/').pop()).filter((name) => name.endsWith('.jpg'));
            assert.deepEqual(asked, order.map(picture));
        }, slow.pass);
    });

    it('shows the nearest picture that is there', async () => {
        const slow = gate();
        await withServed(browser, recording, async (viewer) => {
            for (const frame of [0, 8, 16]) slow.open(picture(frame));
            await viewer.waitFor(0);
            for (let i = 0; i < 6; ++i) await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(8);
            assert.equal(await viewer.wanted(), 6);
            slow.open('all');
            await viewer.waitFor(6);
        }, slow.pass);
    });

    it('asks for nothing but itself and its pictures, each once, and stores nothing', () =>
        withServed(browser, recording, async (viewer, server) => {
            await viewer.loaded();
            await pause(300);
            const expected = ['Plate-viewer.html', ...Array.from({ length: FRAMES }, (_, frame) => picture(frame))];
            assert.deepEqual([...server.asked].sort(), expected.sort());
            const own = server.address('');
            for (const url of viewer.requests)
                assert.ok(url.startsWith(own) || url.startsWith('data:') || url.startsWith('blob:'), url);
            assert.deepEqual(await viewer.context.cookies(), []);
            assert.equal(await viewer.page.evaluate(() => localStorage.length + sessionStorage.length), 0);
            assert.deepEqual(viewer.mistakes, []);
        }));

    it('may not reach anywhere else', () => withServed(browser, recording, async (viewer) => {
        const reached = await viewer.page.evaluate(async () => {
            const tries = [fetch('http://127.0.0.1:9/x'), new Promise((resolve, reject) => {
                const image = new Image();
                image.onload = resolve;
                image.onerror = reject;
                image.src = 'http://127.0.0.1:9/x.jpg';
            })];
            return (await Promise.allSettled(tries)).map((one) => one.status);
        });
        assert.deepEqual(reached, ['rejected', 'rejected']);
        const refusals = viewer.mistakes.filter((line) => /Content Security Policy/.test(line));
        assert.ok(refusals.length >= 2, viewer.mistakes.join('\n'));
    }));

    it('works from disk', () => withOpened(browser, recording.address, {}, async (viewer) => {
        await viewer.loaded();
        await viewer.page.keyboard.press('End');
        await viewer.waitFor(FRAMES - 1);
        assert.deepEqual(viewer.mistakes, []);
    }));

    it('says so when its pictures are not beside it', () =>
        alone(readFileSync(recording.file), (address) => withOpened(browser, address, {}, async (viewer) => {
            await viewer.page.getByText('Keep this page in the folder of its pictures').waitFor();
        })));

    it('sees ten thousand pictures whole in its first pass, and goes to any of them', async () => {
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        for (let frame = 0; frame < 10000; ++frame)
            linkSync(join(recording.out, picture(0)), join(folder, picture(frame)));
        writePage(folder);
        const slow = gate();
        for (let frame = 0; frame < 10000; frame += 256) slow.open(picture(frame));
        await withServed(browser, { out: folder, file: recording.file }, async (viewer) => {
            await viewer.waitFor(0);
            const slider = viewer.page.locator('#slider');
            assert.equal(await slider.getAttribute('max'), '9999');
            await slider.fill('5000');
            await viewer.waitFor(5120);
            const pictures = viewer.requests.map((url) => url.split('/').pop()).filter((name) => name.endsWith('.jpg'));
            assert.deepEqual(pictures.slice(0, 4), [0, 256, 512, 768].map(picture));
        }, slow.pass);
        rmSync(folder, { recursive: true });
    });

    it('shows a picture of another size in its own proportions', async () => {
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        cpSync(recording.out, folder, { recursive: true });
        const upright = record(['turntable', '--frames', '1'], { size: '120x240' });
        cpSync(join(upright.out, picture(0)), join(folder, picture(1)));
        writePage(folder, '--one-file');
        await withOpened(browser, pathToFileURL(join(folder, 'Plate-viewer.html')).href, {}, async (viewer) => {
            await viewer.loaded();
            await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(1);
            const isCovered = (x) => viewer.page.evaluate((at) => document.getElementById('picture')
                .getContext('2d').getImageData(at, 300, 1, 1).data[3] === 255, x);
            assert.equal(await isCovered(480), true);
            assert.equal(await isCovered(100), false, 'it is not drawn wide');
            assert.deepEqual(viewer.mistakes, []);
        });
        upright.remove();
        rmSync(folder, { recursive: true });
    });

    it('shows the others when one cannot be loaded, and says so', async () => {
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        cpSync(recording.out, folder, { recursive: true });
        rmSync(join(folder, picture(3)));
        await withServed(browser, { out: folder, file: recording.file }, async (viewer) => {
            await viewer.loaded();
            await viewer.page.getByText('1 of 24 pictures could not be loaded.').waitFor();
            for (let i = 0; i < 3; ++i) await viewer.page.keyboard.press('ArrowLeft');
            await viewer.page.waitForFunction(() => document.getElementById('stage').dataset.frame === '3');
            assert.ok([2, 4].includes(await viewer.shown()));
        });
        rmSync(folder, { recursive: true });
    });
});

describe('A viewer page as one file', () => {
    let browser;
    let recording;
    before(async () => {
        recording = record(TURNTABLE, { extra: ['--one-file'] });
        browser = await startBrowser();
    });
    after(async () => {
        await browser?.close();
        recording?.remove();
    });

    it('opens from disk alone, and asks for nothing', () =>
        alone(readFileSync(recording.file), (address) => withOpened(browser, address, {}, async (viewer) => {
            await viewer.loaded();
            for (const key of ['End', 'Home']) await viewer.page.keyboard.press(key);
            await viewer.waitFor(0);
            assert.deepEqual(viewer.mistakes, []);
            assert.deepEqual(viewer.requests.filter((url) => !/^(data|blob):/.test(url)), [address]);
        })));

    it('turns what has come of it where the rest never comes', () => {
        const page = readFileSync(recording.file, 'utf8');
        const begun = page.slice(0, page.indexOf('id="frame-4"'));
        return alone(begun, (address) => withOpened(browser, address, {}, async (viewer) => {
            await viewer.waitFor(0);
            for (let i = 0; i < 7; ++i) await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(8);
        }));
    });

    it('is about a third larger than its pictures', () => {
        let pictures = 0;
        for (let frame = 0; frame < FRAMES; ++frame) pictures += statSync(join(recording.out, picture(frame))).size;
        const page = statSync(recording.file).size;
        assert.ok(page > 1.3 * pictures && page < 1.34 * pictures + 120_000, `${page} for ${pictures}`);
    });
});
