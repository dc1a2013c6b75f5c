// The playground: applies the settings that the controls change to the element and to the address.
import './style.css';
import type { ErrorCode, WaterElement } from 'tidemark-water';
import { makeHistory } from './history';
import { makePanel } from './panel';
import { makePictures, offered } from './pictures';
import { randomSettings } from './random';
import { canRecord, record, type Recording } from './record';
import { fromHash, toHash, type Settings } from './settings';
import { copy, download } from './share';

const element = <T extends HTMLElement>(id: string) => document.querySelector<T>(`#${id}`)!;
const water = element<WaterElement>('water');
const settings: Settings = fromHash(location.hash);
const past = makeHistory(settings);
const usualRain = 14;
const isSmall = () => matchMedia('(max-width: 900px), (max-height: 560px)').matches;

let recording: Recording | undefined;
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

// Hides the message after five seconds, unless it describes a lasting state.
function say(text: string, stays = false): void {
    clearTimeout(messageDue);
    element('message').textContent = text;
    element('message').classList.toggle('shown', text !== '');
    if (!stays) messageDue = window.setTimeout(() => say('', true), 5000);
}

const showTools = () => document.body.classList.add('open');

const pictures = makePictures(water, (shown, reason) => {
    showTools();
    if (shown) settings.picture = shown;
    if (reason) say(reason);
    panel.refresh();
});

function writeAddress(): void {
    try {
        history.replaceState(null, '', `#${toHash(settings)}`);
    } catch {
        // WebKit allows a hundred calls in ten seconds. The next change writes the address.
    }
}

function apply(): void {
    const { picture, preset, ink, inkColor, rain, look } = settings;
    Object.assign(water, { preset, ink, inkColor, rain, look: { ...look } });
    element('ink').ariaPressed = String(ink);
    element('hint').classList.toggle('dry', !ink);
    element('rain').ariaPressed = String(rain > 0);
    pictures.show(picture);
    panel.refresh();
    clearTimeout(addressDue);
    const { hash } = location;  // a link that is followed before the timer fires has its own settings
    addressDue = window.setTimeout(() => location.hash === hash && writeAddress(), 300);
}

function replace(chosen: Settings): void {
    Object.assign(settings, chosen);
    past.settle();
    apply();
}

const toggleInk = () => replace({ ...settings, ink: !settings.ink });
const toggleRain = () => replace({ ...settings, rain: settings.rain > 0 ? 0 : usualRain });
const random = () => replace(randomSettings(settings));
const undo = () => (past.undo(), apply());
const openFiles = () => element('files').click();
const hideHint = () => element('hint').classList.add('gone');

async function copied(text: string, what: string): Promise<void> {
    say((await copy(text)) ? `${what} copied.` : `This browser does not let the page copy. Please select the text and copy it.`);
}
async function savePicture(): Promise<void> {
    await water.toBlob('image/png').then((blob) => download(blob, 'tidemark.png'), () => say('There is no picture to save yet.'));
}
function toggleFullScreen(): void {
    if (document.fullscreenElement) void document.exitFullscreen();
    else document.documentElement.requestFullscreen().catch(() => say('This browser does not let the page fill the screen.'));
}
async function toggleRecording(): Promise<void> {
    if (recording) return recording.stop();
    try {
        recording = record(water.canvas!);
        document.body.classList.add('recording');
        element('record').textContent = 'Stop recording';
        say('Recording: move the water. “Stop” ends it, or a minute.');
        const clip = await recording.clip;
        if (clip.size > 0) download(clip, `tidemark.${clip.type.split('/')[1]}`);
        else say('Nothing moved, so there is no clip.');
    } catch {
        say('This browser could not record the water.');
    }
    recording = undefined;
    document.body.classList.remove('recording');
    element('record').textContent = 'Record a clip';
}

function toggle(part: 'panel' | 'share', open = element(part).hidden): void {
    element(part).hidden = !open;
    if (open && part === 'share') hideHint();  // it would be below the menu
    element(part === 'panel' ? 'look' : 'more').ariaExpanded = String(open);
    if (part === 'panel' && open && water.hasAttribute('shown')) void panel.drawThumbnails();
}
const panel = makePanel(element('panel'), settings, {
    changed: apply,
    chooseOwnPicture: () => (pictures.hasPhoto && settings.picture !== 'photo' ? replace({ ...settings, picture: 'photo' }) : openFiles()),
    random,
    undo,
    canUndo: past.canUndo,
    copy: copied,
});

function take(pictureOrFiles: File[] | string): void {
    if (typeof pictureOrFiles === 'string') return replace({ ...settings, picture: pictureOrFiles });
    pictures.takePhotos(pictureOrFiles);
    replace({ ...settings, picture: 'photo' });
}

for (const type of ['change', 'click']) element('panel').addEventListener(type, past.settle);

const buttons: Record<string, () => unknown> = {
    ink: toggleInk,
    rain: toggleRain,
    clear: () => water.clearInk(),
    picture: openFiles,
    more: () => (recording ? toggleRecording() : toggle('share')),
    full: toggleFullScreen,
    look: () => toggle('panel'),
    link: () => copied(`${location.href.split('#')[0]}#${toHash(settings)}`, 'The link is'),
    save: savePicture,
    record: toggleRecording,
};
for (const [id, press] of Object.entries(buttons)) element(id).onclick = press;
element('full').hidden = !document.fullscreenEnabled;
element('record').hidden = !canRecord;

const keys: Record<string, () => unknown> = {
    i: toggleInk,
    r: toggleRain,
    c: () => water.clearInk(),
    n: random,
    f: toggleFullScreen,
    escape: () => (element('share').hidden ? toggle('panel', false) : toggle('share', false)),
};
addEventListener('keydown', (event) => {
    const key = event.key.toLowerCase();  // with Caps Lock the letters are capitals
    if (event.altKey) return;
    if (!event.ctrlKey && !event.metaKey) return void keys[key]?.();
    if (key !== 'z' || event.shiftKey) return;
    event.preventDefault();
    undo();
});
addEventListener('pointerdown', ({ target }) => {
    if (!(target as Element).closest('#share, #more')) toggle('share', false);
});
element('share').onclick = () => toggle('share', false);

element<HTMLInputElement>('files').onchange = ({ target }) => {
    const input = target as HTMLInputElement;
    if (input.files!.length > 0) take([...input.files!]);
    input.value = '';  // so that choosing the same file again is a change
};
function takeOffered(data: DataTransfer | null): void {
    const pictureOrFiles = offered(data);
    if (pictureOrFiles) take(pictureOrFiles);
    else say('That is neither a picture nor the address of one.');
}
addEventListener('paste', ({ clipboardData }) => takeOffered(clipboardData));
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
    takeOffered(event.dataTransfer);
});
addEventListener('hashchange', () => {
    const chosen = fromHash(location.hash);
    replace(settings.picture === 'photo' ? { ...chosen, picture: 'photo' } : chosen);
});

water.addEventListener('pointerdown', hideHint);
water.addEventListener('ready', () => {
    showTools();
    setTimeout(hideHint, 9000);
    if (!element('panel').hidden) setTimeout(() => void panel.drawThumbnails(), 1000);
});
water.addEventListener('error', ({ detail: { code, message } }) => {
    say(sentences[code] ?? message, ['webgl', 'simd', 'csp', 'module'].includes(code));
});
water.addEventListener('contextlost', () => say('The browser took the graphics away. They come back by themselves.', true));
water.addEventListener('contextrestored', () => say('', true));
setInterval(() => {
    if (!element('panel').hidden) panel.showStatus(water);
}, 500);

const isBare = new URLSearchParams(location.search).get('ui') === '0';
if (isBare) document.body.classList.add('bare');
toggle('panel', !isBare && !isSmall());
apply();
// For the browser's console.
Object.assign(window, { tidemark: { settings, apply, water } });
if (import.meta.env.PROD) void navigator.serviceWorker?.register('./service_worker.js');
