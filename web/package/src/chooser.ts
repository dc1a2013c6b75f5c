// Loads the picture under the water and the light on it. Of several requests the last one wins.
import type { Options } from './attributes.js';
import { WaterError } from './errors.js';
import type { Graphics } from './graphics.js';
import { Slot, slotOf } from './native.js';
import { greyPicture, loadPicture, placeOf, plainPicture, shippedLight, uploadCover, type Picture, type Source } from './pictures.js';

interface Owner {
    pictureChanged(): void;
    lightChanged(): void;
    /** `isNeeded` is false for the light, without which the water is drawn as well. */
    failed(error: WaterError, isNeeded: boolean): void;
    /** A video plays, or was moved to another time. */
    moved(): void;
}

const lightSide = 512;
const nothing = Symbol();  // no request yet
const grey = Symbol();
type Chosen = Source | symbol | null;

export class Chooser {
    picture: Picture | undefined;
    light: Picture | undefined;

    private source: Chosen = nothing;
    private lightSource: Chosen = nothing;
    private failed = false;
    private last = new AbortController();  // of the last request

    constructor(private readonly owner: Owner) {}

    choose(pictures: Options, isPortrait: boolean, isRequested: boolean): void {
        this.choosePicture(pictures, isPortrait, isRequested).catch(() => {});
        void this.chooseLight(pictures.light ?? null);
    }

    /** A picture that did not load is tried again if the page has requested it again, not when the shape changes. */
    async choosePicture(pictures: Options, isPortrait: boolean, isRequested = false): Promise<void> {
        const { src = null, srcPortrait, transparent, fetchPriority } = pictures;
        const source: Chosen = transparent ? grey : isPortrait && srcPortrait ? srcPortrait : src;
        if ((source === this.source && !(isRequested && this.failed)) || source === '') return;
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
                for (const type of ['play', 'seeked']) source.addEventListener(type, () => this.owner.moved(), { signal });
            }
        } catch (error) {
            if (signal.aborted) return;
            this.failed = true;
            this.owner.failed(error as WaterError, true);
            throw error;
        }
        this.owner.pictureChanged();
    }

    private async chooseLight(source: Source | null): Promise<void> {
        if (source === this.lightSource) return;
        this.lightSource = source;
        const isLast = () => source === this.lightSource;
        const loaded = source && await loadPicture(source).catch((error) => isLast() && this.owner.failed(error, false));
        const light = loaded || (source && this.light) || await shippedLight();
        if (!isLast()) return;
        this.light = light;
        this.owner.lightChanged();
    }

    /** Fills the bound texture. The library calls this while it draws a frame. */
    fill({ gl, canvas, native }: Graphics, slot: Slot, width: number, height: number): void {
        const isLight = slot === Slot.light;
        if (!isLight && slot !== slotOf(canvas)) return;  // that picture keeps its placeholder of one pixel
        const part = isLight ? 'light' : 'picture';
        const size = isLight ? [lightSide, lightSide] as const : [width, height] as const;
        const place = placeOf(getComputedStyle(canvas).objectPosition);
        const shade = (brightness: number) => native!.shade(slot, brightness);
        try {
            uploadCover(gl!, this[part]!, ...size, place, shade);
        } catch (error) {
            const known = error instanceof WaterError ? error : new WaterError('decode', 'The picture is broken.');
            uploadCover(gl!, (this[part] = plainPicture()), ...size, place, shade);
            // A listener may call the water, which has to finish its frame first.
            queueMicrotask(() => this.owner.failed(known, !isLight));
        }
    }

    end(): void {
        this.last.abort();
        this.lightSource = nothing;
        this.picture = this.light = undefined;
    }
}
