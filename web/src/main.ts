// The page around the element: settings flow from the controls into it and into the address.
import './style.css';
import { WaterError, type ErrorCode, type WaterElement } from 'tidemark-water';
import { makePanel } from './panel';
import { paint } from './pictures';
import { fromHash, src, toHash, type Settings } from './settings';

const element = <T extends HTMLElement>(id: string) => document.querySelector<T>(`#${id}`)!;
const water = element<WaterElement>('water');
const settings: Settings = fromHash(location.hash);
const usualRain = 14;

let photos: File[] = [];
let asked: Settings['picture'] | null = null;
let shown: Settings['picture'] | null = null;
let lastTicket = 0;  // of the picture asked for last
let repaintDue = 0;
let addressDue = 0;
let messageDue = 0;

const sentences: Partial<Record<ErrorCode, string>> = {
    webgl: 'This page needs WebGL, which this browser does not have or has switched off.',
    simd: 'This page needs WebAssembly with SIMD, which this browser does not have.',
    module: 'The water did not load. Please try again.',
    decode: 'That file is not a picture that this browser can show.',
    'cross-origin': 'That picture does not load, or its server does not allow other pages to use it.',
    load: 'That picture does not load.',
};

// Goes by itself, unless it tells that nothing works.
function say(text: string, stays = false): void {
    clearTimeout(messageDue);
    element('message').textContent = text;
    element('message').classList.toggle('shown', text !== '');
    if (!stays) messageDue = window.setTimeout(() => say('', true), 5000);
}

// Of a file that no image shows, false.
async function isPortrait(file: File): Promise<boolean> {
    const image = new Image();
    image.src = URL.createObjectURL(file);
    await new Promise((resolve) => (image.onload = image.onerror = resolve));
    URL.revokeObjectURL(image.src);
    return image.naturalHeight > image.naturalWidth;
}

async function showPicture(): Promise<void> {
    const ticket = ++lastTicket;
    const isLast = () => ticket === lastTicket;
    asked = settings.picture;
    const busy = window.setTimeout(() => document.body.classList.add('busy'), 150);
    try {
        if (asked === 'photo') {
            const [first, second] = photos;
            const turned = second && (await isPortrait(first!));
            if (!isLast()) return;
            await water.setPicture(turned ? second : first!, (turned ? first : second) ?? null);
        } else if (asked === 'src') {
            await water.setPicture(src);
        } else {
            const density = Math.min(devicePixelRatio, 2, 2048 / Math.max(water.clientWidth, water.clientHeight));
            const bitmap = await paint(asked, Math.round(water.clientWidth * density), Math.round(water.clientHeight * density));
            if (isLast()) await water.setPicture(bitmap);
        }
        if (isLast()) shown = asked;
    } catch (error) {
        if (!isLast()) return;
        asked = shown;
        if (shown) settings.picture = shown;
        // The element has told its own errors.
        if (!(error instanceof WaterError)) say(String((error as Error).message));
        panel.refresh();
    } finally {
        clearTimeout(busy);
        if (isLast()) document.body.classList.remove('busy');
    }
}

const apply = () => {
    if (settings.picture === 'photo' && photos.length === 0) {
        settings.picture = asked ?? 'pool';
        element('files').click();
    }
    const { preset, ink, inkColor, rain, look } = settings;
    Object.assign(water, { preset, ink, inkColor, rain, look: { ...look } });
    element('ink').ariaPressed = String(ink);
    element('rain').ariaPressed = String(rain > 0);
    if (settings.picture !== asked) void showPicture();
    panel.refresh();
    // Some browsers refuse more than a hundred changes in ten seconds.
    clearTimeout(addressDue);
    addressDue = window.setTimeout(() => {
        try {
            history.replaceState(null, '', `#${toHash(settings)}`);
        } catch {
            // Then the next change brings it.
        }
    }, 300);
};
const panel = makePanel(element('panel'), settings, apply);

async function takePhotos(files: File[]): Promise<void> {
    if (files.length === 0) return;
    photos = files;
    settings.picture = 'photo';
    if (asked === 'photo') void showPicture();
    apply();
}
function toggle(name: 'ink' | 'rain'): void {
    if (name === 'ink') settings.ink = !settings.ink;
    else settings.rain = settings.rain > 0 ? 0 : usualRain;
    apply();
}
function togglePanel(open = element('panel').hidden): void {
    element('panel').hidden = !open;
    element('look').ariaPressed = String(open);
}
const hideHint = () => element('hint').classList.add('gone');

element('ink').onclick = () => toggle('ink');
element('rain').onclick = () => toggle('rain');
element('clear').onclick = () => water.clearInk();
element('photo').onclick = () => element('files').click();
element('look').onclick = () => togglePanel();
element<HTMLInputElement>('files').onchange = ({ target }) => {
    const input = target as HTMLInputElement;
    void takePhotos([...input.files!]);
    input.value = '';  // the same file again is a change as well
};
addEventListener('keydown', ({ key, target, ctrlKey, metaKey, altKey }) => {
    if (target instanceof HTMLInputElement || ctrlKey || metaKey || altKey) return;
    if (key === 'i') toggle('ink');
    if (key === 'r') toggle('rain');
    if (key === 'c') water.clearInk();
    if (key === 'Escape') togglePanel(false);
});
addEventListener('dragover', (event) => {
    event.preventDefault();
    document.body.classList.add('dropping');
});
addEventListener('dragleave', ({ relatedTarget }) => {
    if (!relatedTarget) document.body.classList.remove('dropping');
});
addEventListener('drop', (event) => {
    event.preventDefault();
    document.body.classList.remove('dropping');
    void takePhotos([...event.dataTransfer!.files]);
});
addEventListener('hashchange', () => {
    Object.assign(settings, fromHash(location.hash), asked === 'photo' ? { picture: asked } : {});
    apply();
});
// Painted pictures fit one size; until the next is painted the last one serves, cropped.
addEventListener('resize', () => {
    clearTimeout(repaintDue);
    if (asked && asked !== 'photo' && asked !== 'src') repaintDue = window.setTimeout(showPicture, 250);
});

water.addEventListener('pointerdown', hideHint);
water.addEventListener('ready', () => setTimeout(hideHint, 9000));
water.addEventListener('error', ({ detail: { code, message } }) => {
    say(sentences[code] ?? message, ['webgl', 'simd', 'csp', 'module'].includes(code));
});
water.addEventListener('contextlost', () => say('The browser took the graphics away. They come back by themselves.', true));
water.addEventListener('contextrestored', () => say('', true));
setInterval(() => {
    if (!element('panel').hidden && water.water) panel.showStatus(water.water);
}, 500);

if (new URLSearchParams(location.search).get('ui') === '0') document.body.classList.add('bare');
togglePanel(!matchMedia('(max-width: 900px), (max-height: 560px)').matches);
apply();
// For the browser's console.
Object.assign(window, { tidemark: { settings, apply, water } });
if (import.meta.env.PROD) void navigator.serviceWorker?.register('./service_worker.js');
