// The page: settings flow from the controls into the water, touches from the pointers, frames out of the loop.
import './style.css';
import { Loop } from './loop';
import { makePanel } from './panel';
import { paint, readPhotos, type Photos } from './pictures';
import { followPointers } from './pointers';
import { fromHash, toHash, type PictureName, type Settings } from './settings';
import { fitToScreen } from './stage';
import { hasVectors, say } from './support';
import { openWater, type Water } from './water';

const element = <T extends HTMLElement>(id: string) => document.querySelector<T>(`#${id}`)!;
const canvas = element<HTMLCanvasElement>('water');

function run(water: Water): void {
    const settings: Settings = fromHash(location.hash);
    const light = paint('light', 512, 512);
    let photos: Photos | null = null;
    let shown: PictureName = settings.picture;
    let pictureDue = 0;
    let lastTicket = 0;  // of the picture asked for last

    const panel = makePanel(settings, () => apply());
    const loop = new Loop(water, panel.showStatus);

    const renewPicture = async () => {
        const ticket = ++lastTicket;
        const under = shown === 'photo' ? photos! : await paint(shown, canvas.width, canvas.height);
        const shine = await light;
        if (ticket !== lastTicket) return;
        const [portrait, landscape] = 'rgba' in under ? [under, under] : [under.portrait, under.landscape];
        water.setPictures(portrait, landscape, shine);
        loop.drawNow();
        canvas.classList.add('shown');
    };
    const apply = () => {
        if (settings.picture === 'photo' && !photos) {
            settings.picture = shown;
            element('files').click();
        }
        water.setLook(settings.look);
        water.setInk(settings.ink);
        water.setRain(settings.rain);
        element('ink').ariaPressed = String(settings.ink);
        element('rain').ariaPressed = String(settings.rain);
        if (settings.picture !== shown) {
            shown = settings.picture;
            void renewPicture();
        }
        history.replaceState(null, '', `#${toHash(settings)}`);
        panel.refresh();
        loop.wake();
    };
    const takePhotos = async (files: File[]) => {
        if (files.length === 0) return;
        const read = await readPhotos(files, water.largestPicture);
        say(read ? '' : 'That file is not a picture that this browser can read.');
        if (!read) return;
        photos = read;
        settings.picture = shown = 'photo';
        await renewPicture();
        apply();
    };
    const toggle = (name: 'ink' | 'rain') => {
        settings[name] = !settings[name];
        apply();
    };
    const clearInk = () => {
        water.clearInk();
        loop.wake();
    };

    fitToScreen(canvas);
    water.resize(canvas.width, canvas.height);
    new ResizeObserver(() => {
        if (!fitToScreen(canvas)) return;
        water.resize(canvas.width, canvas.height);
        loop.drawNow();
        // Painted pictures fit one size; until the next is painted the last one serves, cropped.
        clearTimeout(pictureDue);
        if (shown !== 'photo') pictureDue = window.setTimeout(renewPicture, 200);
    }).observe(canvas);

    followPointers(canvas, water, () => {
        element('hint').classList.add('gone');
        loop.wake();
    });
    element('ink').onclick = () => toggle('ink');
    element('rain').onclick = () => toggle('rain');
    element('clear').onclick = clearInk;
    element('photo').onclick = () => element('files').click();
    element<HTMLInputElement>('files').onchange = ({ target }) => takePhotos([...(target as HTMLInputElement).files!]);
    addEventListener('keydown', ({ key, target, ctrlKey, metaKey, altKey }) => {
        if (target instanceof HTMLInputElement || ctrlKey || metaKey || altKey) return;
        if (key === 'i') toggle('ink');
        if (key === 'r') toggle('rain');
        if (key === 'c') clearInk();
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
        Object.assign(settings, fromHash(location.hash), shown === 'photo' ? { picture: 'photo' } : {});
        apply();
    });
    canvas.addEventListener('webglcontextlost', (event) => {
        event.preventDefault();
        loop.pause();
    });
    canvas.addEventListener('webglcontextrestored', () => {
        water.renewContext();
        loop.resume();
    });

    apply();
    void renewPicture();
    // For the browser's console.
    Object.assign(window, { tidemark: { settings, apply, water, loop } });
}

async function start(): Promise<void> {
    if (!hasVectors()) {
        say('This page needs WebAssembly with SIMD, which this browser does not have.');
        return;
    }
    const water = await openWater();
    if (water) {
        run(water);
    } else {
        say('This page needs WebGL, which this browser does not have or has switched off.');
    }
}

void start();
if (import.meta.env.PROD) void navigator.serviceWorker?.register('./service_worker.js');
