// How fast a viewer page opens and turns, measured by the browser itself.
//
//     node bench/page/viewer.mjs PAGE [RUNS]
//
// PAGE is a viewer page of a turntable, best one with its pictures inside. Printed are, as medians
// of RUNS (5 by default): when after the navigation the first picture was drawn, when a drag showed
// another one, when all were loaded; and while the mouse drags for two seconds, how many pictures a
// second were shown and how many frames the browser's own trace says it drew.
// Needs the packages that `./dev setup` fetches for tests/page.
import { createRequire } from 'node:module';
import { pathToFileURL } from 'node:url';

const { chromium } = createRequire(new URL('../../tests/page/', import.meta.url))('playwright-core');
const OPTIONS = ['--no-sandbox', '--disable-dev-shm-usage', '--disable-background-networking'];
const WINDOW = { width: 1440, height: 900 };
const DRAG_MS = 2000;
const MOUSE_MS = 8;

const [page, runs = '5'] = process.argv.slice(2);
if (!page) {
    console.error('usage: node bench/page/viewer.mjs PAGE [RUNS]');
    process.exit(2);
}

// Runs in the page from its start: notes when the stage shows what.
function watch() {
    window.noted = { changes: [] };
    const look = (now) => {
        const stage = document.getElementById('stage');
        const shown = stage?.dataset.shown;
        if (shown !== undefined && shown !== window.noted.shown) {
            window.noted.first ??= performance.now();
            window.noted.changes.push(now);
            window.noted.shown = shown;
        }
        if (window.noted.first && document.getElementById('ring').hasAttribute('hidden'))
            window.noted.loaded ??= performance.now();
        requestAnimationFrame(look);
    };
    requestAnimationFrame(look);
}

async function turnOnce(tab) {
    await tab.waitForFunction(() => window.noted?.first, null, { polling: 'raf' });
    const shown = await tab.evaluate(() => window.noted.shown);
    await tab.mouse.move(700, 450);
    await tab.mouse.down();
    await tab.mouse.move(900, 450, { steps: 4 });
    const turned = await tab.waitForFunction(
        (before) => window.noted.shown !== before && performance.now(), shown, { polling: 'raf' });
    const time = await turned.jsonValue();
    await tab.mouse.up();
    return time;
}

// Moves the mouse to and fro as often as a good mouse tells, whether or not the page keeps up.
async function drag(tab) {
    const input = await tab.context().newCDPSession(tab);
    const send = (type, x) => input.send('Input.dispatchMouseEvent',
        { type, x, y: 450, button: 'left', buttons: 1, clickCount: 1 });
    await send('mousePressed', 300);
    const start = performance.now();
    const sent = [];
    for (let x = 300, step = 11; performance.now() - start < DRAG_MS; x += step) {
        if (x + step > 1200 || x + step < 250) step = -step;
        sent.push(send('mouseMoved', x));
        await new Promise((resolve) => setTimeout(resolve, MOUSE_MS));
    }
    await Promise.all(sent);
    await send('mouseReleased', 300);
    return (performance.now() - start) / 1000;
}

async function tracedDrag(browser, tab) {
    await browser.startTracing(tab, { categories: ['devtools.timeline', 'disabled-by-default-devtools.timeline.frame'] });
    const before = await tab.evaluate(() => window.noted.changes.length);
    const seconds = await drag(tab);
    const after = await tab.evaluate(() => window.noted.changes.length);
    const trace = JSON.parse(await browser.stopTracing());
    const drawn = trace.traceEvents.filter((event) => event.name === 'DrawFrame').length;
    return { shown: (after - before) / seconds, drawn: drawn / seconds };
}

async function measure(address) {
    const browser = await chromium.launch({ executablePath: process.env.CHROMIUM ?? '/usr/bin/chromium', args: OPTIONS });
    try {
        const tab = await browser.newPage({ viewport: WINDOW });
        await tab.addInitScript(watch);
        await tab.goto(address, { waitUntil: 'commit' });
        const turned = await turnOnce(tab);
        await tab.waitForFunction(() => window.noted.loaded);
        const { first, loaded } = await tab.evaluate(() => window.noted);
        return { first, turned, loaded, ...await tracedDrag(browser, tab) };
    } finally {
        await browser.close();
    }
}

function median(values) {
    const sorted = [...values].sort((a, b) => a - b);
    return sorted[Math.floor(sorted.length / 2)];
}

const all = [];
for (let run = 0; run < Number(runs); ++run) all.push(await measure(pathToFileURL(page).href));
const of = (name) => median(all.map((one) => one[name])).toFixed(0);
console.log(`first picture ${of('first')} ms, turned ${of('turned')} ms, all loaded ${of('loaded')} ms; ` +
    `dragging: ${of('shown')} pictures/s shown, ${of('drawn')} frames/s drawn`);
