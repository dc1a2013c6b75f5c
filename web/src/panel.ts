// The panel: what a visitor chooses in plain words, values of the look under "Expert", and the choice as code.
import { lookKeys, lookOf, presets, type LookKey, type Water } from 'tidemark-water';
import properties from '../../host/look.properties?raw';
import { toCpp, toHtml, toJava, toJavaScript } from './code';
import { pictureNames, withPreset, type PictureName, type Settings } from './settings';

const inks = {
    Blue: '#0d2673', Violet: '#4d1a80', Red: '#99080d', Amber: '#994d05', Green: '#0d5926', Black: '#1c1c1c',
};
const rains = [[0, 'none'], [4, 'a few drops'], [14, 'drizzle'], [34, 'rain'], [60, 'downpour']] as const;
// The others tune how a host works, have a place of their own above, or are not read by the shaders of today.
const expert: Record<string, string[]> = {
    Waves: ['ringSpeed', 'dropRadius', 'calmingTime', 'touchAmplitude', 'trailShare', 'trailCells'],
    Light: ['refractiveIndex', 'alphaMix', 'alphaScale1', 'fresnelRatio', 'specularRatio', 'exponent'],
    View: ['meshExtent'],
};
const keyOf = (name: string) => lookKeys.find((key) => key.name === name)!;

// What stands above each value in the file.
const helpOf = (name: string) =>
    new RegExp(`((?:# .*\\n)+)${name} =`).exec(properties)?.[1]?.replace(/^# /gm, '').replace(/\n/g, ' ').trim() ?? '';

// Between a slider's positions: a power of ten, for thirty of them at least.
const stepOf = ({ whole, min, max }: LookKey) => (whole ? 1 : 10 ** Math.floor(Math.log10((max - min) / 30)));

function make<Tag extends keyof HTMLElementTagNameMap>(
    tag: Tag, properties: Partial<HTMLElementTagNameMap[Tag]> = {}, ...children: (Node | string)[]
): HTMLElementTagNameMap[Tag] {
    const element = Object.assign(document.createElement(tag), properties);
    element.append(...children);
    return element;
}

// `settings` is changed in place, and `changed` called after each change.
export function makePanel(root: HTMLElement, settings: Settings, changed: () => void) {
    const refreshers: (() => void)[] = [];
    const section = (title: string, ...children: Node[]) => make('fieldset', {}, make('legend', {}, title), ...children);
    const choice = (title: string, chosen: () => boolean, choose: () => void) => {
        const button = make('button', { type: 'button', onclick: () => (choose(), changed()) }, title);
        refreshers.push(() => (button.ariaPressed = String(chosen())));
        return button;
    };
    const slider = (title: string, key: Pick<LookKey, 'min' | 'max'>, step: number, help: string, get: () => number,
        set: (value: number) => void, word: (value: number) => string) => {
        const input = make('input', { type: 'range', min: String(key.min), max: String(key.max), step: String(step), ariaLabel: title });
        const output = make('output');
        input.oninput = () => (set(Number(input.value)), changed());
        refreshers.push(() => {
            input.value = String(get());
            output.textContent = word(get());
        });
        return make('label', { title: help }, make('span', {}, title), input, output);
    };
    const look = () => lookOf(settings);
    const setLook = (name: string) => (value: number) => (settings.look[name] = Number(value.toFixed(4)));

    const pictures = Object.entries(pictureNames).map(([name, title]) =>
        choice(title, () => settings.picture === name, () => (settings.picture = name as PictureName)));
    const named = Object.entries(presets).map(([name, { title }]) =>
        choice(title, () => settings.preset === name && Object.keys(settings.look).length === 0,
            () => Object.assign(settings, withPreset(name))));

    const swatches = Object.entries(inks).map(([title, color]) => {
        const swatch = choice('', () => settings.inkColor === color, () => Object.assign(settings, { inkColor: color, ink: true }));
        swatch.ariaLabel = swatch.title = title;
        swatch.className = 'swatch';
        swatch.style.background = color;
        return swatch;
    });
    const own = make('input', { type: 'color', title: 'Another colour', ariaLabel: 'Another colour' });
    own.oninput = () => (Object.assign(settings, { inkColor: own.value, ink: true }), changed());
    refreshers.push(() => (own.value = settings.inkColor));

    const { min: soonest, max: latest } = keyOf('calmingTime');
    const words = (value: number, { min, max }: { min: number; max: number }, names: string[]) =>
        names[Math.min(names.length - 1, Math.floor((names.length * (value - min)) / (max - min)))]!;
    const calmness = { min: 0, max: 1 };
    const plain = section('Water',
        slider('Strength', keyOf('touchAmplitude'), 0.1, 'How high a touch raises the water', () => look().touchAmplitude!,
            setLook('touchAmplitude'), (value) => words(value, keyOf('touchAmplitude'), ['gentle', 'lively', 'strong', 'wild'])),
        slider('Calmness', calmness, 0.01, 'How soon the water rests again',
            () => Math.log(latest / look().calmingTime!) / Math.log(latest / soonest),
            (value) => setLook('calmingTime')(latest * (soonest / latest) ** value),
            (value) => words(value, calmness, ['lingers', 'swings', 'settles', 'rests soon'])),
        slider('Rain', { min: 0, max: 60 }, 1, 'Drops a second', () => settings.rain, (value) => (settings.rain = value),
            (value) => rains.find(([drops]) => value <= drops)![1]));

    const status = make('p', { className: 'status' }, make('i'), make('span'));
    const values = Object.entries(expert).map(([title, names]) =>
        section(title, ...names.map((name) =>
            slider(name, keyOf(name), stepOf(keyOf(name)), helpOf(name), () => look()[name]!, setLook(name), String))));
    const details = make('details', {}, make('summary', {}, 'Expert'), status, ...values);

    const copies = Object.entries({ HTML: toHtml, JavaScript: toJavaScript, Java: toJava, 'C++': toCpp }).map(([language, text]) => {
        const button = make('button', { type: 'button', title: `Copy as ${language}` }, language);
        button.onclick = async () => {
            const copied = await navigator.clipboard?.writeText(text(settings)).then(() => true, () => false);  // on plain HTTP there is none
            button.textContent = copied ? 'Copied' : 'Not allowed';
            setTimeout(() => (button.textContent = language), 1500);
        };
        return button;
    });

    const row = (className: string, ...children: Node[]) => make('div', { className }, ...children);
    root.append(section('Picture', row('chips', ...pictures)), section('Preset', row('chips', ...named)),
        section('Ink', row('swatches', ...swatches, own)), plain, section('Copy as', row('chips', ...copies)), details);

    return {
        refresh: () => refreshers.forEach((refresh) => refresh()),
        showStatus({ calm, cost }: Water) {
            status.classList.toggle('calm', calm);
            const rate = cost.frame ? `${cost.frame.toFixed(1)} ms a frame, ` : '';
            status.lastElementChild!.textContent = calm ? 'Calm: no frames are drawn' : `Moving: ${rate}${cost.work.toFixed(1)} ms busy`;
        },
    };
}
