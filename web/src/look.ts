// The numbers of host/look.properties, which the hosts in C++ and Java read as well.
import properties from '../../host/look.properties?raw';

export type Look = Record<string, number>;

export interface LookKey {
    name: string;
    value: number;
    whole: boolean;
    help: string;
}

// In the file's order, which is that of the fields in C++.
export const lookKeys: LookKey[] = [];

let help = '';
for (const line of properties.split('\n')) {
    const [name, value] = line.split('=').map((part) => part.trim());
    if (line.startsWith('#')) {
        help = `${help} ${line.slice(1).trim()}`.trim();
    } else if (name && value) {
        lookKeys.push({ name, value: Number(value), whole: !value.includes('.'), help });
        help = '';
    }
}

export const defaultLook = (): Look => Object.fromEntries(lookKeys.map(({ name, value }) => [name, value]));

export interface Slider {
    key: string;
    min: number;
    max: number;
    step: number;
}

const slider = (key: string, min: number, max: number, step: number): Slider => ({ key, min, max, step });

// The values that change the look, by what they change; the others tune how a host works.
export const sliders: Record<string, Slider[]> = {
    Waves: [
        slider('damping', 0.9, 0.998, 0.001),
        slider('waveSpeed', 0.05, 0.48, 0.01),
        slider('stepsPerSecond', 30, 120, 1),
        slider('touchAmplitude', 0.2, 4, 0.1),
        slider('trailShare', 0, 1, 0.01),
        slider('trailCells', 0.5, 5, 0.1),
    ],
    Light: [
        slider('refractiveIndex', 1, 2.5, 0.01),
        slider('alphaMix', 0, 1, 0.01),
        slider('alphaScale1', 0, 1, 0.01),
        slider('alphaScale2', 0, 1, 0.01),
        slider('fresnelRatio', 0, 2, 0.01),
        slider('specularRatio', 1, 10, 0.1),
        slider('exponent', 1, 200, 1),
    ],
    Rain: [slider('rainDropsPerSecond', 0, 60, 0.5), slider('rainAmplitude', 0.2, 2, 0.1)],
    Mesh: [slider('meshVertices', 16, 256, 1), slider('meshExtent', 16, 64, 1)],
};

// Brighter ink would light the picture up.
export const inkKeys = ['inkRed', 'inkGreen', 'inkBlue'].map((key) => slider(key, 0, 0.75, 0.001));

export const chosenKeys: Slider[] = [...Object.values(sliders).flat(), ...inkKeys];
