import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';
import { after, before, describe, it } from 'node:test';
import { startBrowser } from './recorded-page.mjs';
import { openViewer, record, serve } from './viewer-page.mjs';

const FEW = ['turntable', '--frames', '3'];
const HOSTILE_TITLE = "</title></script><script>window.broken=1</script><img src=x onerror=window.broken=2> {{texts}} & 'A' \u202Egnp.exe";
const HOSTILE_NAME = "A&b 'c' %41 #1 \u202Egnp";

let browser;
before(async () => { browser = await startBrowser(); });
after(async () => { await browser?.close(); });

describe('A viewer page with a hostile name and title', () => {
    let recording;
    before(() => {
        recording = record(FEW, { name: HOSTILE_NAME });
    });
    after(() => { recording?.remove(); });

    for (const form of ['beside its pictures', 'as one file'])
        it(`${form} runs nothing of theirs, and shows them as they are`, async () => {
            recording.page('--title', HOSTILE_TITLE, ...(form === 'as one file' ? ['--one-file'] : []));
            const viewer = await openViewer(browser, recording.address);
            await viewer.loaded();
            assert.equal(await viewer.page.evaluate(() => window.broken), undefined);
            assert.equal(await viewer.page.title(), HOSTILE_TITLE);
            assert.equal(await viewer.page.locator('h1').textContent(), HOSTILE_TITLE);
            assert.equal(await viewer.page.locator('h1 > bdi').count(), 1);
            assert.equal(await viewer.page.locator('img').count(), 1);
            await viewer.page.keyboard.press('End');
            await viewer.waitFor(2);
            assert.deepEqual(viewer.mistakes, []);
            await viewer.close();
        });

    it('can be embedded by the line that it shows', async () => {
        const server = await serve(recording.out);
        const viewer = await openViewer(browser, server.address(`${HOSTILE_NAME}-viewer.html`));
        await viewer.loaded();
        await viewer.page.locator('#more').click();
        const line = await viewer.page.locator('#embed-line').inputValue();
        const host = await viewer.context.newPage();
        await host.goto('about:blank');
        await host.setContent(`<!DOCTYPE html><main style="width: 480px">${line}</main>`);
        const frame = host.frameLocator('iframe');
        await frame.locator('#stage.drawn').waitFor();
        assert.equal(await host.locator('main > *').count(), 1);
        const box = await host.locator('iframe').boundingBox();
        assert.ok(Math.abs(box.width / box.height - 16 / 9) < 0.01, `${box.width} x ${box.height}`);
        await viewer.close();
        await server.stop();
    });
});

describe('A viewer page', () => {
    let recording;
    before(() => { recording = record(FEW, { extra: ['--one-file'] }); });
    after(() => { recording?.remove(); });

    const words = { 'de-AT': 'Abspielen', 'es': 'Reproducir', 'fr-CA': 'Lire', 'ja-JP': '再生', 'zh-Hans-CN': '播放', 'pt': 'Play' };
    for (const [locale, play] of Object.entries(words))
        it(`speaks to a reader of ${locale}`, async () => {
            const viewer = await openViewer(browser, recording.address, { locale });
            await viewer.loaded();
            assert.equal(await viewer.page.locator('#play').getAttribute('aria-label'), play);
            assert.equal(await viewer.page.evaluate(() => document.documentElement.lang), locale === 'pt' ? 'en' : locale.slice(0, 2));
            await viewer.close();
        });

    it('is dark for a reader who has it dark', async () => {
        const ground = async (colorScheme) => {
            const viewer = await openViewer(browser, recording.address, { colorScheme });
            const colour = await viewer.page.evaluate(() => getComputedStyle(document.body).backgroundColor);
            await viewer.close();
            return Number(/\d+/.exec(colour)[0]);
        };
        assert.ok(await ground('light') > 200);
        assert.ok(await ground('dark') < 40);
    });

    it('shows its first picture where no script may run', async () => {
        const viewer = await openViewer(browser, recording.address, { javaScriptEnabled: false });
        const width = await viewer.page.locator('#first').evaluate((image) => image.complete && image.naturalWidth);
        assert.equal(width, 320);
        await viewer.close();
    });

    it('has no button to play where there is one picture alone', async () => {
        const one = record(['turntable', '--frames', '1']);
        const viewer = await openViewer(browser, one.address);
        await viewer.loaded();
        await viewer.waitFor(0);
        for (const id of ['#play', '#loop', '#rate', '#hint']) assert.equal(await viewer.page.locator(id).isVisible(), false, id);
        assert.deepEqual(viewer.mistakes, []);
        await viewer.close();
        one.remove();
    });

    it('uses every text of its table', () => {
        const page = readFileSync(recording.file, 'utf8');
        const texts = JSON.parse(/id="texts">(.*?)<\/script>/s.exec(page)[1]).en;
        const rest = page.slice(0, page.indexOf('id="texts"')) + page.slice(page.indexOf("'use strict'"), page.indexOf('id="frame-'));
        for (const key of Object.keys(texts)) assert.match(rest, new RegExp(`['"]${key}['"]`), key);
    });
});
