// Records clips of a canvas.

// The first type that the browser supports is used. The size of the canvas may change during a clip: avc3 allows that, avc1
// does not.
const types = ['video/mp4;codecs=avc3', 'video/webm;codecs=vp9', 'video/webm', 'video/mp4'];
const longest = 60_000;  // milliseconds

export const canRecord = typeof MediaRecorder === 'function' && 'captureStream' in HTMLCanvasElement.prototype;

export interface Recording {
    stop(): void;
    /** Resolves after stop() or a minute. Empty if nothing was drawn. */
    clip: Promise<Blob>;
}

export function record(canvas: HTMLCanvasElement): Recording {
    const stream = canvas.captureStream();
    const recorder = new MediaRecorder(stream, {
        mimeType: types.find((type) => MediaRecorder.isTypeSupported(type)),
        videoBitsPerSecond: 12_000_000,
    });
    const parts: Blob[] = [];
    const stop = () => recorder.state !== 'inactive' && recorder.stop();
    const end = setTimeout(stop, longest);
    const clip = new Promise<Blob>((resolve, reject) => {
        recorder.ondataavailable = ({ data }) => parts.push(data);
        recorder.onerror = () => reject(new Error('This browser could not record the water.'));
        recorder.onstop = () => {
            clearTimeout(end);
            for (const track of stream.getTracks()) track.stop();
            resolve(new Blob(parts, { type: recorder.mimeType.split(';')[0] }));
        };
    });
    recorder.start();
    return { stop, clip };
}
