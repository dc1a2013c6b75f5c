// Loads the picture under the water: a painting, an address, or photos of the visitor. Of two photos, the portrait one is
// shown in portrait and the landscape one in landscape.
import { WaterError, type WaterElement } from 'tidemark-water';
import { isGround } from './grounds';
import { paint } from './paintings';
import { addressOf } from './settings';

async function isPortrait(file: File): Promise<boolean> {
    const image = new Image();
    image.src = URL.createObjectURL(file);
    await image.decode().catch(() => {});  // a broken file has no size
    URL.revokeObjectURL(image.src);
    return image.naturalHeight > image.naturalWidth;
}

function sizeOf({ clientWidth, clientHeight }: WaterElement): [number, number] {
    const density = Math.min(devicePixelRatio, 2, 2048 / Math.max(clientWidth, clientHeight));
    return [Math.round(clientWidth * density), Math.round(clientHeight * density)];
}

export interface Pictures {
    readonly hasPhoto: boolean;
    takePhotos(files: File[]): void;
    /** Shows the picture with this name, unless it was requested last. */
    show(picture: string): void;
}

// Calls `failed` with the picture that is still shown, and with a reason unless the water has sent an `error` event.
export function makePictures(water: WaterElement, failed: (shown: string | null, reason?: string) => void): Pictures {
    let photos: File[] = [];
    let asked: string | null = null;
    let shown: string | null = null;
    let lastTicket = 0;  // of the picture that was requested last
    let repaintDue = 0;
    let painted = '';    // the size of the last painting, in pixels

    async function load(picture: string, isLast: () => boolean): Promise<void> {
        if (isGround(picture)) {
            const size = sizeOf(water);
            painted = String(size);
            const bitmap = await paint(picture, ...size);
            if (isLast()) await water.setPicture(bitmap);
        } else if (picture === 'photo') {
            const [first, second] = photos;
            const turned = second && (await isPortrait(first!));
            if (isLast()) await water.setPicture(turned ? second : first!, (turned ? first : second) ?? null);
        } else {
            await water.setPicture(picture);
        }
    }

    async function replace(picture: string): Promise<void> {
        const ticket = ++lastTicket;
        const isLast = () => ticket === lastTicket;
        asked = picture;
        const busy = setTimeout(() => document.body.classList.add('busy'), 150);
        try {
            await load(picture, isLast);
            if (isLast()) shown = picture;
        } catch (error) {
            if (!isLast()) return;
            asked = shown;
            failed(shown, error instanceof WaterError ? undefined : (error as Error).message);
        } finally {
            clearTimeout(busy);
            if (isLast()) document.body.classList.remove('busy');
        }
    }

    // A painting fits one size. Until the next one is ready the water crops it.
    addEventListener('resize', () => {
        clearTimeout(repaintDue);
        repaintDue = window.setTimeout(() => {
            if (asked && isGround(asked) && String(sizeOf(water)) !== painted) void replace(asked);
        }, 250);
    });

    return {
        get hasPhoto() {
            return photos.length > 0;
        },
        takePhotos(files) {
            photos = files;
            void replace('photo');
        },
        show: (picture) => void (picture !== asked && replace(picture)),
    };
}

// Files or an address that were dropped or pasted; null for anything else.
export function offered(data: DataTransfer | null): File[] | string | null {
    const files = [...(data?.files ?? [])];
    if (files.length > 0) return files;
    const text = data?.getData('text/uri-list') || data?.getData('text/plain') || '';
    return addressOf(text.trim().split('\n')[0]!);
}
