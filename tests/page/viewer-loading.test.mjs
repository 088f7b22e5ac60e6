import assert from 'node:assert/strict';
import { copyFileSync, mkdtempSync, readFileSync, rmSync, statSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { pathToFileURL } from 'node:url';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';
import { openViewer, record, serve, TURNTABLE } from './viewer-page.mjs';

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
        const server = await serve(recording.out, slow.pass);
        const viewer = await openViewer(browser, server.address('Plate-viewer.html'));
        try {
            slow.open(picture(0));
            await viewer.waitFor(0);
            await viewer.page.locator('#ring').waitFor({ state: 'visible' });
            slow.open('all');
            await viewer.loaded();
            assert.equal(await viewer.page.locator('#ring').isVisible(), false);
            const order = [0, 8, 16, 4, 12, 20, 2, 6, 10, 14, 18, 22];
            for (let frame = 1; frame < FRAMES; frame += 2) order.push(frame);
            assert.deepEqual(server.asked.slice(1), order.map(picture));
        } finally {
            await viewer.close();
            await server.stop();
        }
    });

    it('shows the nearest picture that is there', async () => {
        const slow = gate();
        const server = await serve(recording.out, slow.pass);
        const viewer = await openViewer(browser, server.address('Plate-viewer.html'));
        try {
            for (const frame of [0, 8, 16]) slow.open(picture(frame));
            await viewer.waitFor(0);
            for (let i = 0; i < 6; ++i) await viewer.page.keyboard.press('ArrowLeft');
            await viewer.waitFor(8);
            assert.equal(await viewer.wanted(), 6);
            slow.open('all');
            await viewer.waitFor(6);
        } finally {
            await viewer.close();
            await server.stop();
        }
    });

    it('asks for nothing but itself and its pictures, each once, and stores nothing', async () => {
        const server = await serve(recording.out);
        const viewer = await openViewer(browser, server.address('Plate-viewer.html'));
        try {
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
        } finally {
            await viewer.close();
            await server.stop();
        }
    });

    it('may not reach anywhere else', async () => {
        const server = await serve(recording.out);
        const viewer = await openViewer(browser, server.address('Plate-viewer.html'));
        try {
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
            assert.ok(viewer.mistakes.some((line) => /Content Security Policy/.test(line)), viewer.mistakes.join('\n'));
        } finally {
            await viewer.close();
            await server.stop();
        }
    });

    it('works from disk', async () => {
        const viewer = await openViewer(browser, recording.address);
        await viewer.loaded();
        await viewer.page.keyboard.press('End');
        await viewer.waitFor(FRAMES - 1);
        assert.deepEqual(viewer.mistakes, []);
        await viewer.close();
    });

    it('says so when its pictures are not beside it', async () => {
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        copyFileSync(recording.file, join(folder, 'alone.html'));
        const viewer = await openViewer(browser, pathToFileURL(join(folder, 'alone.html')).href);
        await viewer.page.getByText('Keep this page in the folder of its pictures').waitFor();
        await viewer.close();
        rmSync(folder, { recursive: true });
    });

    it('shows the others when one cannot be loaded, and says so', async () => {
        const server = await serve(recording.out);
        const viewer = await openViewer(browser, 'about:blank');
        await viewer.page.route(`**/${picture(3)}`, (route) => route.fulfill({ status: 404 }));
        await viewer.page.goto(server.address('Plate-viewer.html'));
        await viewer.loaded();
        await viewer.page.getByText('1 of 24 pictures could not be loaded.').waitFor();
        for (let i = 0; i < 3; ++i) await viewer.page.keyboard.press('ArrowLeft');
        await viewer.page.waitForFunction(() => document.getElementById('stage').dataset.frame === '3');
        assert.ok([2, 4].includes(await viewer.shown()));
        await viewer.close();
        await server.stop();
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

    it('opens from disk alone, and asks for nothing', async () => {
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        copyFileSync(recording.file, join(folder, 'alone.html'));
        const address = pathToFileURL(join(folder, 'alone.html')).href;
        const viewer = await openViewer(browser, address);
        await viewer.loaded();
        for (const frame of ['End', 'Home']) await viewer.page.keyboard.press(frame);
        await viewer.waitFor(0);
        assert.deepEqual(viewer.mistakes, []);
        assert.deepEqual(viewer.requests.filter((url) => !/^(data|blob):/.test(url)), [address]);
        await viewer.close();
        rmSync(folder, { recursive: true });
    });

    it('turns what has come of it while the rest is on its way', async () => {
        const page = readFileSync(recording.file, 'utf8');
        const begun = page.slice(0, page.indexOf('id="frame-4"'));
        const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
        writeFileSync(join(folder, 'begun.html'), begun);
        const viewer = await openViewer(browser, pathToFileURL(join(folder, 'begun.html')).href);
        await viewer.waitFor(0);
        for (let i = 0; i < 7; ++i) await viewer.page.keyboard.press('ArrowLeft');
        await viewer.waitFor(8);
        await viewer.close();
        rmSync(folder, { recursive: true });
    });

    it('is about a third larger than its pictures', () => {
        let pictures = 0;
        for (let frame = 0; frame < FRAMES; ++frame) pictures += statSync(join(recording.out, picture(frame))).size;
        const page = statSync(recording.file).size;
        assert.ok(page > 1.3 * pictures && page < 1.34 * pictures + 120_000, `${page} for ${pictures}`);
    });
});
