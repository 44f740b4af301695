// Prints as JSON how many seconds a report's page takes until it is drawn, and at most to zoom in and
// out again: the best of three. Ends with status 3 where the packages or Chromium are missing.
//
// usage: node measure.mjs PAGE
import { existsSync } from 'node:fs';
import { pathToFileURL } from 'node:url';

const executablePath = process.env.CHROMIUM ?? '/usr/bin/chromium';
const { chromium } = await import('playwright-core').catch(() => ({}));
if (chromium === undefined || !existsSync(executablePath)) process.exit(3);

const browser = await chromium.launch({ executablePath, chromiumSandbox: process.getuid() !== 0 });
const best = { drawn: Infinity, zoomed: Infinity };
for (let round = 0; round < 3; ++round) {
    const page = await browser.newPage({ viewport: { width: 1440, height: 900 } });
    await page.goto(pathToFileURL(process.argv[2]).href);
    await page.waitForSelector('html[data-ready]', { state: 'attached', timeout: 60000 });
    const [drawn, zoomed] = await page.evaluate(async () => {
        const drawnAt = performance.getEntriesByName('drawn')[0].startTime;
        const model = globalThis.pallaxModels[0];
        const timeOf = async (act) => {
            const begin = performance.now();
            act();
            await new Promise((done) => requestAnimationFrame(() => requestAnimationFrame(done)));
            return performance.now() - begin;
        };
        const zoomIn = await timeOf(() => model.zoom(0.5));
        return [drawnAt, Math.max(zoomIn, await timeOf(() => model.showAll()))];
    });
    best.drawn = Math.min(best.drawn, drawn / 1000);
    best.zoomed = Math.min(best.zoomed, zoomed / 1000);
    await page.close();
}
await browser.close();
console.log(JSON.stringify(best));
