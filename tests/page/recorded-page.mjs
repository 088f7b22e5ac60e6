// Records small animations with the built program, and opens their pages in the browser.
import { spawnSync } from 'node:child_process';
import { mkdirSync, mkdtempSync, readdirSync, rmSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { fileURLToPath, pathToFileURL } from 'node:url';
import { chromium } from 'playwright-core';

const BROWSER_OPTIONS = [
    '--no-sandbox', '--disable-dev-shm-usage', '--disable-gpu', '--disable-background-networking',
    '--disable-component-update', '--disable-sync', '--no-first-run',
];

const HOSTILE = fileURLToPath(new URL('../data/hostile', import.meta.url));

// The page shows the next frame after this time.
export const FRAME_DELAY_MS = 75;

export const screenshotFolder = process.env.QUARN_SCREENSHOTS ?? tmpdir();

// A low box with a tall one on a corner: no two sides look the same.
function house() {
    const lines = [];
    const addBox = ([x0, y0, z0], [x1, y1, z1]) => {
        const first = lines.filter((line) => line.startsWith('v')).length + 1;
        for (let corner = 0; corner < 8; ++corner)
            lines.push(`v ${corner & 1 ? x1 : x0} ${corner & 2 ? y1 : y0} ${corner & 4 ? z1 : z0}`);
        const faces = [[0, 2, 3, 1], [4, 5, 7, 6], [0, 1, 5, 4], [2, 6, 7, 3], [0, 4, 6, 2],
                       [1, 3, 7, 5]];
        for (const face of faces) lines.push(`f ${face.map((i) => i + first).join(' ')}`);
    };
    addBox([0, 0, 0], [4, 2, 1]);
    addBox([0, 0, 1], [1, 1, 4]);
    return lines.join('\n') + '\n';
}

// Records into a folder of its own.
// Returns the address of the page, and what takes the folder away again.
function record(command, options, { name, width = 320, height = 180 }) {
    const folder = mkdtempSync(join(tmpdir(), 'quarn-page-'));
    writeFileSync(join(folder, 'house.obj'), house());
    const out = join(folder, 'out');
    const run = spawnSync(process.env.QUARN_PROGRAM, [
        command, join(folder, 'house.obj'), ...options, '--out', out,
        '--size', `${width}x${height}`, '--name', name, '--language', 'en',
    ], { encoding: 'utf8' });
    if (run.status !== 0) throw new Error(`quarn ended with ${run.status}: ${run.stderr}`);
    return {
        address: pathToFileURL(join(out, `${name}.html`)).href,
        remove: () => rmSync(folder, { recursive: true, force: true }),
    };
}

export function recordTurntable({ frames, ...common }) {
    return record('turntable', ['--frames', String(frames)], common);
}

// The animation that a document of tests/data/hostile holds. Its page is the only one in the folder.
export function recordHostile(document) {
    const folder = mkdtempSync(join(tmpdir(), 'quarn-page-'));
    const out = join(folder, 'out');
    mkdirSync(out);
    writeFileSync(join(folder, 'script.txt'), `_-RecordAnimation _TargetFolder "${out}" _Enter\n`);
    const run = spawnSync(process.env.QUARN_PROGRAM,
        ['run', join(folder, 'script.txt'), join(HOSTILE, document), '--language', 'en'],
        { encoding: 'utf8' });
    if (run.status !== 0) throw new Error(`quarn ended with ${run.status}: ${run.stderr}`);
    const pages = readdirSync(out).filter((name) => name.endsWith('.html'));
    return {
        address: pathToFileURL(join(out, pages[0])).href,
        remove: () => rmSync(folder, { recursive: true, force: true }),
    };
}

// A turntable whose first frame cannot be written, as a folder of its name is in the way: the page of
// a recording without a single picture.
export function recordNothing({ name }) {
    const folder = mkdtempSync(join(tmpdir(), 'quarn-page-'));
    const out = join(folder, 'out');
    mkdirSync(join(out, `${name}000.jpg`), { recursive: true });
    writeFileSync(join(folder, 'house.obj'), house());
    writeFileSync(join(folder, 'script.txt'), [
        `_-AnimationName "${name}"`,
        '_-SetTurntableAnimation 3 _Enter _Enter _Enter _Enter _Enter',
        `_-RecordAnimation "${out}" _Enter`,
    ].join('\n') + '\n');
    const run = spawnSync(process.env.QUARN_PROGRAM,
        ['run', join(folder, 'script.txt'), join(folder, 'house.obj'), '--language', 'en'],
        { encoding: 'utf8' });
    if (run.status !== 1 || !run.stderr.includes(`${name}.html shows nothing`))
        throw new Error(`quarn ended with ${run.status}: ${run.stderr}`);
    return {
        address: pathToFileURL(join(out, `${name}.html`)).href,
        remove: () => rmSync(folder, { recursive: true, force: true }),
    };
}

// The sun over Athens, from one time to another, every so many minutes.
export function recordDay({ date, from, to, every, ...common }) {
    return record('day', ['--place', 'Athens', '--date', date, '--from', from, '--to', to,
                          '--every', String(every)], common);
}

export function startBrowser() {
    return chromium.launch({ executablePath: process.env.CHROMIUM, args: BROWSER_OPTIONS });
}

// Opens a page whose time stands still until the test lets it run, and hands out what a person
// sees of it and does with it.
export async function openRecorded(browser, address) {
    const page = await browser.newPage({ viewport: { width: 480, height: 420 } });
    const mistakes = [];
    page.on('pageerror', (error) => mistakes.push(error.message));
    page.on('requestfailed', (request) => mistakes.push(`not found: ${request.url()}`));
    await page.clock.install({ time: 0 });
    await page.clock.pauseAt(1000);
    await page.goto(address);
    const picture = page.locator('#animated_image');
    return {
        page,
        mistakes,
        toggle: page.locator('#btnToggle'),
        first: page.locator('#btnFirst'),
        previous: page.locator('#btnPrev'),
        next: page.locator('#btnNext'),
        last: page.locator('#btnLast'),
        loop: page.locator('#checkLoop'),
        counterBox: page.locator('#checkCounter'),
        counter: page.locator('#frame_title'),
        // The number in the name of the picture that is shown, from 0.
        async shownFrame() {
            const source = await picture.evaluate((image) => decodeURI(image.src));
            return Number(/(\d{3,})\.jpg$/.exec(source)[1]);
        },
        async caption() {
            return page.locator('#frame_title').innerText();
        },
        // Lets so many frames pass.
        async play(frames) {
            await page.clock.runFor(frames * FRAME_DELAY_MS);
        },
    };
}
