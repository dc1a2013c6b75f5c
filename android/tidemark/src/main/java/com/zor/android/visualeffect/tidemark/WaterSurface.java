package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.graphics.SurfaceTexture;
import android.view.SurfaceHolder;
import android.view.SurfaceView;
import android.view.TextureView;
import android.view.View;

/** The child of a {@link TidemarkView} on which the water is drawn: with a surface of its own, or on a texture. */
final class WaterSurface implements SurfaceHolder.Callback, TextureView.SurfaceTextureListener {
    interface Listener {
        /**
         * Called with a Surface or a SurfaceTexture and its size in pixels; with null when the water must not draw any
         * more, which must be true when the method returns.
         */
        void setWindow(Object window, int width, int height);
    }

    // A SurfaceView with a fixed size would measure itself by that.
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
    private final SurfaceView surfaceView;  // null if there is a textureView
    private final TextureView textureView;
    private SurfaceTexture texture;  // null while the textureView has none
    private int width;  // of the texture, pixels
    private int height;
    private boolean isVisible = true;

    WaterSurface(Context context, boolean onTexture, Listener listener) {
        this.listener = listener;
        surfaceView = onTexture ? null : new FillingSurface(context);
        textureView = onTexture ? new TextureView(context) : null;
        if (onTexture) {
            textureView.setSurfaceTextureListener(this);
        } else {
            surfaceView.getHolder().addCallback(this);
        }
    }

    View view() {
        return surfaceView != null ? surfaceView : textureView;
    }

    /** Sets how many pixels are drawn. The display, or the window, scales them to the view. */
    void setSize(int width, int height) {
        if (surfaceView != null) {
            surfaceView.getHolder().setFixedSize(width, height);
        } else if (texture != null) {
            this.width = width;
            this.height = height;
            texture.setDefaultBufferSize(width, height);
            setTexture();
        }
    }

    /** Stops drawing on a texture, which outlives the visibility of its window. A surface does not. */
    void setVisible(boolean isVisible) {
        this.isVisible = isVisible;
        if (texture != null) setTexture();
    }

    private void setTexture() {
        listener.setWindow(isVisible ? texture : null, width, height);
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
        setTexture();
    }

    // The parameters are the size of the view. The texture keeps the one of setSize().
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
