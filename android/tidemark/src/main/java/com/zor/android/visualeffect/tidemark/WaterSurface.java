package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.graphics.SurfaceTexture;
import android.view.SurfaceHolder;
import android.view.SurfaceView;
import android.view.TextureView;
import android.view.View;

/** The child of a {@link TidemarkView} on which the water is drawn: a surface of its own, or a texture of the window's. */
final class WaterSurface implements SurfaceHolder.Callback, TextureView.SurfaceTextureListener {
    interface Listener {
        /** Null when the water must no longer draw there, which it does not when the method returns. */
        void setWindow(Object window, int width, int height);
    }

    // One of a fixed size would measure as many pixels as that has.
    private static final class FillingSurface extends SurfaceView {
        FillingSurface(Context context) {
            super(context);
        }

        @Override
        protected void onMeasure(int widthSpec, int heightSpec) {
            setMeasuredDimension(getDefaultSize(0, widthSpec), getDefaultSize(0, heightSpec));
        }
    }

    private final Listener listener;
    private final SurfaceView own;  // or
    private final TextureView shared;
    private SurfaceTexture texture;
    private int width;
    private int height;
    private boolean isSeen = true;

    WaterSurface(Context context, boolean onTexture, Listener listener) {
        this.listener = listener;
        own = onTexture ? null : new FillingSurface(context);
        shared = onTexture ? new TextureView(context) : null;
        if (onTexture) {
            shared.setSurfaceTextureListener(this);
        } else {
            own.getHolder().addCallback(this);
        }
    }

    View view() {
        return own != null ? own : shared;
    }

    /** In so many pixels the water is drawn; the display's scaler or the window's does the rest. */
    void setSize(int width, int height) {
        if (own != null) {
            own.getHolder().setFixedSize(width, height);
        } else if (texture != null) {
            this.width = width;
            this.height = height;
            texture.setDefaultBufferSize(width, height);
            handOver();
        }
    }

    /** A surface of its own goes with its window; a texture stays. */
    void setSeen(boolean isSeen) {
        this.isSeen = isSeen;
        if (texture != null) handOver();
    }

    private void handOver() {
        listener.setWindow(isSeen ? texture : null, width, height);
    }

    @Override
    public void surfaceCreated(SurfaceHolder holder) {}

    @Override
    public void surfaceChanged(SurfaceHolder holder, int format, int width, int height) {
        listener.setWindow(holder.getSurface(), width, height);
    }

    @Override
    public void surfaceDestroyed(SurfaceHolder holder) {
        listener.setWindow(null, 0, 0);
    }

    @Override
    public void onSurfaceTextureAvailable(SurfaceTexture texture, int width, int height) {
        this.texture = texture;
        this.width = width;
        this.height = height;
        handOver();
    }

    // The size of the view; that of the texture is what setSize() has made it.
    @Override
    public void onSurfaceTextureSizeChanged(SurfaceTexture texture, int width, int height) {
        texture.setDefaultBufferSize(this.width, this.height);
    }

    @Override
    public boolean onSurfaceTextureDestroyed(SurfaceTexture texture) {
        this.texture = null;
        listener.setWindow(null, 0, 0);
        return true;
    }

    @Override
    public void onSurfaceTextureUpdated(SurfaceTexture texture) {}
}
