// The numbers of host/look.properties, which the hosts in C++ and Java keep to as well.
import properties from '../../host/look.properties?raw';

export type Look = Record<string, number>;

export interface LookKey {
    name: string;
    value: number;
    whole: boolean;
    help: string;
    min: number;  // of the range that looks well
    max: number;
}

// In the file's order, which is that of the fields in C++.
export const lookKeys: LookKey[] = [];

for (const entry of properties.matchAll(/((?:# .*\n)+)# range (\S+) to (\S+), limits .*\n(\w+) = (\S+)/g)) {
    const [help, min, max, name, value] = entry.slice(1) as [string, string, string, string, string];
    lookKeys.push({
        name,
        value: Number(value),
        whole: !value.includes('.'),
        help: help.replace(/^# /gm, '').replace(/\n/g, ' ').trim(),
        min: Number(min),
        max: Number(max),
    });
}

export const defaultLook = (): Look => Object.fromEntries(lookKeys.map(({ name, value }) => [name, value]));

const keys = (...names: string[]) => names.map((name) => lookKeys.find((key) => key.name === name)!);

// The values that change the look, by what they change; the others tune how a host works.
export const sliders: Record<string, LookKey[]> = {
    Waves: keys('ringSpeed', 'dropRadius', 'calmingTime', 'touchAmplitude', 'trailShare', 'trailCells'),
    Light: keys('refractiveIndex', 'alphaMix', 'alphaScale1', 'alphaScale2', 'fresnelRatio', 'specularRatio', 'exponent'),
    Rain: keys('rainDropsPerSecond', 'rainAmplitude'),
    Mesh: keys('meshExtent'),
};

export const inkKeys = keys('inkRed', 'inkGreen', 'inkBlue');

export const chosenKeys: LookKey[] = [...Object.values(sliders).flat(), ...inkKeys];

// Between a slider's positions: a power of ten, for thirty of them at least.
export const stepOf = ({ whole, min, max }: LookKey) => (whole ? 1 : 10 ** Math.floor(Math.log10((max - min) / 30)));
