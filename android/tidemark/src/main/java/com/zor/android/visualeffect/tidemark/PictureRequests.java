package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.graphics.Bitmap;
import android.util.DisplayMetrics;

import java.io.IOException;
import java.util.Arrays;

/** The pictures that an app asks a view to show, which are decoded on another thread. Used on the main thread. */
final class PictureRequests {
    interface Listener {
        void decoded(Pictures pictures);
    }

    private final Context context;
    private final TidemarkRenderer.Listener failures;
    private final Listener listener;

    // For portrait, landscape and light a Bitmap, the number of a resource, a Uri, or null.
    private Object[] sources = {null, null, null};  // of the last request
    private Object[] decodedSources = sources;  // of the last request that could be decoded
    private Pictures decoded;

    PictureRequests(Context context, TidemarkRenderer.Listener failures, Listener listener) {
        this.context = context;
        this.failures = failures;
        this.listener = listener;
    }

    Object[] sources() {
        return sources;
    }

    /** Does nothing if the last request was the same, because Compose repeats calls. */
    void request(Object portrait, Object landscape, Object light) {
        Object[] wanted = {portrait != null ? portrait : landscape, landscape != null ? landscape : portrait, light};
        if (wanted[0] == null) throw new IllegalArgumentException("there is no background picture");
        if (Arrays.equals(wanted, sources)) return;
        sources = wanted;
        DisplayMetrics display = context.getResources().getDisplayMetrics();
        int leastSide = Math.max(display.widthPixels, display.heightPixels);
        PictureLoader.post(() -> {
            try {
                Pictures pictures = decode(wanted, leastSide);
                TidemarkRenderer.MAIN.post(() -> succeed(wanted, pictures));
            } catch (IOException | RuntimeException | OutOfMemoryError e) {
                TidemarkRenderer.MAIN.post(() -> fail(wanted, e.toString()));
            }
        });
    }

    private Pictures decode(Object[] wanted, int leastSide) throws IOException {
        Bitmap portrait = PictureLoader.load(context, wanted[0], leastSide);
        boolean isSame = wanted[1].equals(wanted[0]);
        Bitmap landscape = isSame ? portrait : PictureLoader.load(context, wanted[1], leastSide);
        Object light = wanted[2] == null ? R.drawable.tidemark_light : wanted[2];
        return new Pictures(portrait, landscape, PictureLoader.load(context, light, leastSide));
    }

    private void succeed(Object[] wanted, Pictures pictures) {
        decodedSources = wanted;
        decoded = pictures;
        if (wanted == sources) listener.decoded(pictures);
    }

    // An earlier request may have been decoded and not been shown, because this one was to replace it.
    private void fail(Object[] wanted, String message) {
        if (wanted != sources) return;
        sources = decodedSources;
        if (decoded != null) listener.decoded(decoded);
        failures.failed(TidemarkListener.Failure.PICTURE, message);
    }
}
