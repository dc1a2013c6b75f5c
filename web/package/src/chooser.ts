// Which picture is under the water and which light on it. Of several asked for, the last one stays.
import type { Options } from './attributes.js';
import type { WaterError } from './errors.js';
import { Slot } from './native.js';
import { greyPicture, loadPicture, plainPicture, shippedLight, uploadCover, type Picture, type Place, type Shade, type Source } from './pictures.js';

interface Told {
    pictureChanged(): void;
    lightChanged(): void;
    /** `isNeeded` is false for the light: the water shows without it. */
    failed(error: WaterError, isNeeded: boolean): void;
    /** A video goes on. */
    moved(): void;
}

const lightSide = 512;
const nothingYet = Symbol();
const grey = Symbol();
type Chosen = Source | symbol | null;

export class Chooser {
    picture: Picture | undefined;
    light: Picture | undefined;

    private source: Chosen = nothingYet;
    private lightSource: Chosen = nothingYet;
    private failed = false;
    private last = new AbortController();  // ends what the last choice has begun

    constructor(private readonly told: Told) {}

    choose(pictures: Options, isPortrait: boolean, anew: boolean): void {
        this.choosePicture(pictures, isPortrait, anew).catch(() => {});
        void this.chooseLight(pictures.light ?? null);
    }

    /** What did not load is loaded again only when it is asked for `anew`. */
    async choosePicture(pictures: Options, isPortrait: boolean, anew = false): Promise<void> {
        const { src = null, srcPortrait, transparent, fetchPriority } = pictures;
        const source: Chosen = transparent ? grey : isPortrait && srcPortrait ? srcPortrait : src;
        if ((source === this.source && !(anew && this.failed)) || source === '') return;
        this.source = source;
        this.failed = false;
        this.last.abort();
        const { signal } = (this.last = new AbortController());
        try {
            const picture = typeof source === 'symbol' ? greyPicture()
                : source ? await loadPicture(source, fetchPriority ?? 'auto') : plainPicture();
            if (signal.aborted) return;
            this.picture = picture;
            if (source instanceof HTMLVideoElement) {
                for (const type of ['play', 'seeked']) source.addEventListener(type, () => this.told.moved(), { signal });
            }
        } catch (error) {
            if (signal.aborted) return;
            this.failed = true;
            this.told.failed(error as WaterError, true);
            throw error;
        }
        this.told.pictureChanged();
    }

    private async chooseLight(source: Source | null): Promise<void> {
        if (source === this.lightSource) return;
        this.lightSource = source;
        const isLast = () => source === this.lightSource;
        const loaded = source && await loadPicture(source).catch((error) => isLast() && this.told.failed(error, false));
        const light = loaded || (source && this.light) || await shippedLight();
        if (!isLast()) return;
        this.light = light;
        this.told.lightChanged();
    }

    /** Fills the texture that is bound, in the middle of a frame. */
    fill(gl: WebGLRenderingContext, slot: Slot, width: number, height: number, place: Place, shade: Shade): void {
        const isLight = slot === Slot.light;
        const part = isLight ? 'light' : 'picture';
        const size = isLight ? [lightSide, lightSide] as const : [width, height] as const;
        try {
            uploadCover(gl, this[part]!, ...size, place, shade);
        } catch (error) {
            uploadCover(gl, (this[part] = plainPicture()), ...size, place, shade);
            // Who hears of it may call in, which is not for the middle of a frame.
            queueMicrotask(() => this.told.failed(error as WaterError, !isLight));
        }
    }

    end(): void {
        this.last.abort();
        this.lightSource = nothingYet;
        this.picture = this.light = undefined;
    }
}
