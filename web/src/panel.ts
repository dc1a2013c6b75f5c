// The panel: every value of the look, presets, and what the water is doing.
import GUI, { type Controller } from 'lil-gui';
import { toCpp, toJava } from './code';
import { inkKeys, sliders, stepOf } from './look';
import type { Status } from './loop';
import { applyPreset, presetNames, presetOf } from './presets';
import { pictureNames, type Settings } from './settings';

function copyButton(gui: GUI, title: string, text: () => string): void {
    const button = gui.add({ copy: async () => {
        const copied = await navigator.clipboard.writeText(text()).then(() => true, () => false);
        button.name(copied ? 'Copied' : 'The browser does not allow it');
        setTimeout(() => button.name(title), 1500);
    } }, 'copy').name(title);
}

// `settings` is changed in place, and `changed` called after each change.
export function makePanel(settings: Settings, changed: () => void) {
    const gui = new GUI({ title: 'The look of the water' });
    if (matchMedia('(max-width: 700px), (max-height: 500px)').matches) gui.close();

    const status = document.createElement('div');
    status.className = 'status';
    status.append(document.createElement('i'), document.createElement('span'));
    gui.$children.append(status);

    const chosen = { preset: presetOf(settings) };
    gui.add(chosen, 'preset', presetNames).name('Preset').onChange((name: string) => {
        applyPreset(name, settings);
        changed();
    });
    const options = Object.fromEntries(Object.entries(pictureNames).map(([key, title]) => [title, key]));
    gui.add(settings, 'picture', options).name('Picture').onChange(changed);

    // The look object is replaced as a whole by presets and links, so the controls reach it through this one.
    const look = new Proxy({} as Record<string, number>, {
        get: (_, key: string) => settings.look[key],
        set: (_, key: string, value: number) => {
            settings.look[key] = Number(value.toFixed(4));
            return true;
        },
    });
    for (const [title, group] of Object.entries(sliders)) {
        const folder = gui.addFolder(title);
        if (title === 'Rain' || title === 'Mesh') folder.close();
        for (const key of group) {
            const control = folder.add(look, key.name, key.min, key.max, stepOf(key)).onChange(changed);
            control.domElement.title = key.help;
        }
    }

    const ink = { colour: { r: 0, g: 0, b: 0 } };
    const readInk = () => {
        [ink.colour.r, ink.colour.g, ink.colour.b] = inkKeys.map(({ name }) => settings.look[name]!) as [number, number, number];
    };
    readInk();
    gui.addColor(ink, 'colour').name('Ink colour').onChange(({ r, g, b }: { r: number; g: number; b: number }) => {
        [r, g, b].forEach((value, i) => {
            look[inkKeys[i]!.name] = Math.min(value, inkKeys[i]!.max);
        });
        changed();
    });

    copyButton(gui, 'Copy as Java', () => toJava(settings));
    copyButton(gui, 'Copy as C++', () => toCpp(settings));

    return {
        refresh() {
            chosen.preset = presetOf(settings);
            readInk();
            gui.controllersRecursive().forEach((control: Controller) => control.updateDisplay());
        },
        showStatus({ calm, frameMs, workMs }: Status) {
            status.classList.toggle('calm', calm);
            const rate = frameMs ? `${frameMs.toFixed(1)} ms a frame, ` : '';
            status.lastElementChild!.textContent =
                calm ? 'Calm: no frames are drawn' : `Moving: ${rate}${workMs.toFixed(1)} ms busy`;
        },
    };
}
