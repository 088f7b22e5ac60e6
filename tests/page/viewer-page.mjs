// Records small animations with their viewer pages, serves them on loopback, and opens them as a
// person with a mouse or a phone does.
import { spawnSync } from 'node:child_process';
import { createServer } from 'node:http';
import { mkdtempSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { basename, join } from 'node:path';
import { pathToFileURL } from 'node:url';

export const DESKTOP = { viewport: { width: 960, height: 600 } };
export const PHONE = { viewport: { width: 390, height: 844 }, deviceScaleFactor: 2, hasTouch: true, isMobile: true };
export const CALM = { reducedMotion: 'reduce' }; // nothing moves by itself

const MATERIALS = `newmtl Ground
Kd 0.75 0.75 0.75
newmtl Red
Kd 0.9 0.02 0.02
`;

// A plate with a red post that stands where a turntable's camera looks from, and a grey one opposite.
function plate() {
    const lines = ['mtllib plate.mtl'];
    let first = 1;
    const addBox = (material, [x0, y0, z0], [x1, y1, z1]) => {
        lines.push(`o ${material}${first}`);
        for (let corner = 0; corner < 8; ++corner)
            lines.push(`v ${corner & 1 ? x1 : x0} ${corner & 2 ? y1 : y0} ${corner & 4 ? z1 : z0}`);
        lines.push(`usemtl ${material}`);
        for (const face of [[0, 2, 3, 1], [4, 5, 7, 6], [0, 1, 5, 4], [2, 6, 7, 3], [0, 4, 6, 2], [1, 3, 7, 5]])
            lines.push(`f ${face.map((corner) => corner + first).join(' ')}`);
        first += 8;
    };
    addBox('Ground', [-10, -10, -1], [10, 10, 0]);
    addBox('Red', [3.5, -7.9, 0], [5, -6.4, 3]);
    addBox('Ground', [-5, 6.4, 0], [-3.5, 7.9, 5]);
    return lines.join('\n') + '\n';
}

function quarn(...words) {
    const run = spawnSync(process.env.QUARN_PROGRAM, [...words, '--language', 'en'], { encoding: 'utf8' });
    if (run.status !== 0) throw new Error(`quarn ended with ${run.status}: ${run.stderr}`);
    return run.stdout;
}

// A recording in a folder of its own.
// kind: the command and its options
export function record(kind, { name = 'Plate', size = '320x180', extra = [] } = {}) {
    const folder = mkdtempSync(join(tmpdir(), 'quarn-viewer-'));
    writeFileSync(join(folder, 'plate.obj'), plate());
    writeFileSync(join(folder, 'plate.mtl'), MATERIALS);
    writeFileSync(join(folder, 'walk.txt'), '-9 -14 2\n-3 -14 2\n4 -15 2\n9 -12 2\n');
    const out = join(folder, 'out');
    const [command, ...options] = kind.map((word) => word === 'walk.txt' ? join(folder, word) : word);
    quarn(command, join(folder, 'plate.obj'), ...options, '--out', out, '--size', size, '--name', name,
        '--viewer', ...extra);
    return {
        out,
        file: join(out, `${name}-viewer.html`),
        address: pathToFileURL(join(out, `${name}-viewer.html`)).href,
        remove: () => rmSync(folder, { recursive: true, force: true }),
    };
}

// Writes the page of a folder anew.
export function writePage(folder, ...options) {
    return quarn('page', folder, ...options);
}

export const TURNTABLE = ['turntable', '--frames', '24'];
export const DAY = ['day', '--place', 'Athens', '--date', '2026-06-21', '--from', '04:00', '--to', '18:00', '--every', '120', '--zone', '+01:00'];

export const WALK = ['flythrough', '--camera-curve', 'walk.txt', '--frames', '10'];

// Serves a folder. before: awaited with the name of each file that is asked for.
// Returns the address, and the names in the order of asking.
export async function serve(folder, before = async () => {}) {
    const asked = [];
    const server = createServer(async (request, answer) => {
        const name = decodeURIComponent(basename(new URL(request.url, 'http://x').pathname));
        asked.push(name);
        await before(name);
        try {
            const bytes = readFileSync(join(folder, name));
            answer.writeHead(200, { 'Content-Type': name.endsWith('.html') ? 'text/html' : 'image/jpeg' });
            answer.end(bytes);
        } catch {
            answer.writeHead(404).end();
        }
    });
    await new Promise((done) => server.listen(0, '127.0.0.1', done));
    return {
        address: (name) => `http://127.0.0.1:${server.address().port}/${encodeURIComponent(name)}`,
        asked,
        stop: () => new Promise((done) => { server.closeAllConnections(); server.close(done); }),
    };
}

// Opens a page, and hands out what a person sees of it and does with it.
export async function openViewer(browser, address, options = {}) {
    const context = await browser.newContext({ ...DESKTOP, ...CALM, locale: 'en-US', ...options });
    const page = await context.newPage();
    const mistakes = [];
    const requests = [];
    page.on('pageerror', (error) => mistakes.push(error.message));
    page.on('console', (line) => { if (line.type() === 'error') mistakes.push(line.text()); });
    page.on('request', (request) => requests.push(request.url()));
    await page.goto(address, { waitUntil: 'commit' });
    const stage = page.locator('#stage');
    const { width, height } = page.viewportSize();
    return {
        page,
        context,
        stage,
        mistakes,
        requests,
        middle: { x: width / 2, y: height / 2 },
        pictureWidth: Math.min(width, height * 16 / 9),
        async shown() { return Number(await stage.getAttribute('data-shown')); },
        async wanted() { return Number(await stage.getAttribute('data-frame')); },
        async waitFor(frame) {
            await page.waitForFunction((number) => document.getElementById('stage').dataset.shown === String(number), frame, { timeout: 8000 });
        },
        // All pictures are there.
        async loaded() {
            await page.waitForFunction(() => document.getElementById('stage').dataset.shown !== undefined &&
                document.getElementById('stage').dataset.loaded === 'all', null, { timeout: 8000 });
        },
        close: () => context.close(),
    };
}

// Opens the page of a recording from a server, and closes both whatever becomes of the test.
export async function withServed(browser, recording, use, before) {
    const server = await serve(recording.out, before);
    let viewer;
    try {
        viewer = await openViewer(browser, server.address(basename(recording.file)));
        await use(viewer, server);
    } finally {
        await viewer?.close();
        await server.stop();
    }
}

// Opens a page from disk, and closes it whatever becomes of the test.
export async function withOpened(browser, address, options, use) {
    const viewer = await openViewer(browser, address, options);
    try {
        await use(viewer);
    } finally {
        await viewer.close();
    }
}

// Where the red post stands in the picture that is shown, as its canvas has it: the mean of its
// points' places across, from 0 to 1. Only of pages whose pictures are inside.
export async function redPlace(viewer) {
    return viewer.page.evaluate(() => {
        const canvas = document.getElementById('picture');
        const { data } = canvas.getContext('2d').getImageData(0, 0, canvas.width, canvas.height);
        let sum = 0;
        let count = 0;
        for (let at = 0; at < data.length; at += 4)
            if (data[at] > 2 * data[at + 1] + 40 && data[at] > 2 * data[at + 2] + 40) {
                sum += (at / 4) % canvas.width;
                ++count;
            }
        return count > 20 ? sum / count / canvas.width : null;
    });
}

// Fingers on a phone, by the browser's own input.
export async function fingers(viewer) {
    const session = await viewer.context.newCDPSession(viewer.page);
    const points = (places) => places.map(([x, y], id) => ({ x, y, id }));
    return (type, ...places) => session.send('Input.dispatchTouchEvent', { type, touchPoints: points(places) });
}
