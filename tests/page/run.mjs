// Runs every *.test.mjs of this folder with node's own test runner.
//
// QUARN_PROGRAM  the built `quarn`
// CHROMIUM       the browser, /usr/bin/chromium by default
// QUARN_SCREENSHOTS  where pictures of the page are left to look at; a temporary folder by default
import { spawnSync } from 'node:child_process';
import { existsSync, readdirSync } from 'node:fs';
import { dirname, join } from 'node:path';
import { fileURLToPath } from 'node:url';

const folder = dirname(fileURLToPath(import.meta.url));
const environment = { CHROMIUM: '/usr/bin/chromium', ...process.env };

function refuse(message) {
    console.error(`page tests: ${message}`);
    process.exit(2);
}

const tests = readdirSync(folder).filter((name) => name.endsWith('.test.mjs')).sort();
if (tests.length === 0) refuse('no *.test.mjs found');
if (!existsSync(join(folder, 'node_modules', 'playwright-core')))
    refuse('playwright-core is not installed; run ./dev setup');
if (!existsSync(environment.CHROMIUM)) refuse(`no browser at ${environment.CHROMIUM}`);
if (!environment.QUARN_PROGRAM || !existsSync(environment.QUARN_PROGRAM))
    refuse('QUARN_PROGRAM must name the built quarn');

const run = spawnSync(process.execPath, ['--test', ...tests.map((name) => join(folder, name))], {
    env: environment,
    stdio: 'inherit',
});
process.exit(run.status ?? 1);
