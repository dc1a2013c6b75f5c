// The panel: presets, pictures, inks and sliders, every value of the look under "Expert", and the settings as code.
import { lookKeys, lookOf, presets, type PresetName, type WaterElement } from 'tidemark-water';
import { codes, toHtml } from './code';
import { make, makeControls, wordOf } from './controls';
import { expertSliders } from './expert';
import { grounds, isGround, type Ground } from './grounds';
import { inks } from './inks';
import { isChanged, withPreset, type Settings } from './settings';
import { drawGround, drawThumbnails } from './thumbnails';

const rains = [[0, 'none'], [4, 'a few drops'], [14, 'drizzle'], [34, 'rain'], [60, 'downpour']] as const;
const nameOf = (names: Readonly<Record<string, string>>, value: string, other: string) =>
    Object.entries(names).find(([, known]) => known === value)?.[0] ?? other;

export interface PanelActions {
    changed(): void;
    chooseOwnPicture(): void;
    random(): void;
    undo(): void;
    canUndo(): boolean;
    copy(text: string, what: string): void;
}

// Changes `settings` in place, and calls `changed` after each change.
export function makePanel(root: HTMLElement, settings: Settings, actions: PanelActions) {
    const controls = makeControls(actions.changed);
    const { follow, section } = controls;
    const row = (className: string, ...children: Node[]) => make('div', { className }, ...children);
    const button = (title: string, onclick: () => void) => make('button', { type: 'button', onclick }, title);

    const choosePreset = (preset: PresetName) => Object.assign(settings, withPreset(preset, settings.picture));
    const tiles = (Object.keys(presets) as PresetName[]).map((name) => {
        const { title } = presets[name];
        const picture = make('i');
        const mark = make('small', {}, 'changed');
        follow(() => (mark.hidden = settings.preset !== name || !isChanged(settings)));
        return { name, picture, tile: controls.choice('', () => settings.preset === name, () => choosePreset(name), picture, title, mark) };
    });
    const surprise = make('button', { type: 'button', className: 'random', onclick: actions.random }, make('i'), 'Random');
    const back = button('', () => (choosePreset(settings.preset), actions.changed()));
    const undo = button('Undo', actions.undo);
    follow(() => {
        back.textContent = `Back to ${presets[settings.preset].title}`;
        back.hidden = !isChanged(settings);
        undo.disabled = !actions.canUndo();
    });

    const pictures = (Object.keys(grounds) as Ground[]).map((name) => {
        return { name, swatch: controls.choice(grounds[name], () => settings.picture === name, () => (settings.picture = name)) };
    });
    const own = make('button', { type: 'button', ariaLabel: 'Your own picture', onclick: actions.chooseOwnPicture }, '+');
    follow(() => (own.ariaPressed = String(!isGround(settings.picture))));

    const isPresetInk = () => settings.inkColor === withPreset(settings.preset).inkColor;
    const swatches = Object.entries(inks).map(([title, color]) => {
        const swatch = controls.choice(title, () => settings.inkColor === color, () => Object.assign(settings, { inkColor: color, ink: true }));
        swatch.style.background = color;
        return swatch;
    });
    const color = make('input', { type: 'color', ariaLabel: 'Another colour' });
    color.oninput = () => (Object.assign(settings, { inkColor: color.value, ink: true }), actions.changed());
    follow(() => (color.value = settings.inkColor));

    const { min: soonest, max: latest } = lookKeys.find(({ name }) => name === 'calmingTime')!;
    const { min: weakest, max: strongest } = lookKeys.find(({ name }) => name === 'touchAmplitude')!;
    const setLook = (name: string, value: number) => (settings.look[name] = Number(value.toFixed(4)));
    const water = section('Water',
        controls.slider({
            title: 'Touches', min: weakest, max: strongest, step: 0.1,
            get: () => lookOf(settings).touchAmplitude!,
            set: (value) => setLook('touchAmplitude', value),
            word: (value) => wordOf(value, weakest, strongest, ['gentle', 'lively', 'strong', 'wild']),
        }),
        controls.slider({
            title: 'Waves', min: 0, max: 1, step: 0.01,
            get: () => Math.log(lookOf(settings).calmingTime! / soonest) / Math.log(latest / soonest),
            set: (value) => setLook('calmingTime', soonest * (latest / soonest) ** value),
            word: (value) => wordOf(value, 0, 1, ['rest soon', 'settle', 'swing', 'linger']),
        }),
        controls.slider({
            title: 'Rain', min: 0, max: 60, step: 1,
            get: () => settings.rain,
            set: (value) => (settings.rain = value),
            word: (value) => rains.find(([drops]) => value <= drops)![1],
        }));

    // Code, and a button that copies it.
    const code = (language: () => string, text: () => string) => {
        const shown = make('code');
        const pre = make('pre', { tabIndex: 0 }, shown);
        const copy = button('', () => actions.copy(text(), language()));
        follow(() => {
            pre.ariaLabel = language();
            shown.textContent = text().trim();
            copy.textContent = `Copy as ${language()}`;
        });
        return [pre, copy];
    };
    let language = Object.keys(codes)[0]!;
    const languages = Object.keys(codes).map((name) => controls.choice(name, () => language === name, () => (language = name), name));

    const status = make('p', { className: 'status' }, make('i'), make('span'));
    root.append(
        section('Preset', row('tiles', ...tiles.map(({ tile }) => tile), surprise), row('actions', undo, back)),
        controls.choices('Picture', () => (isGround(settings.picture) ? grounds[settings.picture] : 'your own'), row('pictures', ...pictures.map(({ swatch }) => swatch), own)),
        controls.choices('Ink colour', () => nameOf(inks, settings.inkColor, isPresetInk() ? 'the preset\'s' : 'custom').toLowerCase(), row('swatches', ...swatches, color)),
        water,
        section('On your page', ...code(() => 'HTML', () => toHtml(settings))),
        make('details', {}, make('summary', {}, 'Expert'), status, ...expertSliders(controls, settings)),
        make('details', {}, make('summary', {}, 'For developers'), row('chips', ...languages),
            ...code(() => language, () => codes[language]!(settings))),
        make('p', { className: 'help fine' }, 'Keys: I ink, R rain, C clear, N random, F full screen, Ctrl+Z undo, Escape closes.'),
    );

    let drawn = false;
    return {
        refresh: controls.refresh,
        /** Call this when the water is visible. */
        async drawThumbnails(): Promise<void> {
            if (drawn) return;
            drawn = true;
            const show = ({ style }: HTMLElement, url: string) => (style.backgroundImage = `url("${url}")`);
            for (const { name, swatch } of pictures) {
                const url = await drawGround(name);
                show(swatch, url);
                for (const { name: preset, picture } of tiles) if (presets[preset].ground === name) show(picture, url);
            }
            await drawThumbnails((preset, url) => show(tiles.find(({ name }) => name === preset)!.picture, url));
        },
        showStatus({ calm, cost }: WaterElement) {
            status.classList.toggle('calm', calm);
            const rate = cost.frame ? `${cost.frame.toFixed(1)} ms a frame, ` : '';
            status.lastElementChild!.textContent = calm ? 'Calm: no frames are drawn' : `Moving: ${rate}${cost.work.toFixed(1)} ms busy`;
        },
    };
}
