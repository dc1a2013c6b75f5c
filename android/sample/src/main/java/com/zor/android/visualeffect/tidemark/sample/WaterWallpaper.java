package com.zor.android.visualeffect.tidemark.sample;

import android.content.SharedPreferences;
import android.net.Uri;
import android.service.wallpaper.WallpaperService;
import android.view.MotionEvent;
import android.view.Surface;
import android.view.SurfaceHolder;

import com.zor.android.visualeffect.tidemark.TidemarkView;

/** Water as a live wallpaper. If the wallpaper and its preview are visible, the newer one draws. */
public final class WaterWallpaper extends WallpaperService {
    @Override
    public Engine onCreateEngine() {
        return new WaterEngine();
    }

    private final class WaterEngine extends Engine implements SharedPreferences.OnSharedPreferenceChangeListener {
        private final SharedPreferences settings = WallpaperSettings.of(WaterWallpaper.this);
        private final TidemarkView water = new TidemarkView(WaterWallpaper.this);
        private Surface surface;
        private int width;
        private int height;

        @Override
        public void onCreate(SurfaceHolder holder) {
            super.onCreate(holder);
            setTouchEventsEnabled(true);
            settings.registerOnSharedPreferenceChangeListener(this);
            onSharedPreferenceChanged(settings, null);
        }

        @Override
        public void onSurfaceChanged(SurfaceHolder holder, int format, int width, int height) {
            surface = holder.getSurface();
            this.width = width;
            this.height = height;
            onVisibilityChanged(isVisible());
        }

        @Override
        public void onSurfaceDestroyed(SurfaceHolder holder) {
            surface = null;
            onVisibilityChanged(false);
        }

        @Override
        public void onVisibilityChanged(boolean visible) {
            water.drawOn(visible ? surface : null, width, height);
        }

        @Override
        public void onTouchEvent(MotionEvent event) {
            water.onTouchEvent(event);
        }

        @Override
        public void onDestroy() {
            settings.unregisterOnSharedPreferenceChangeListener(this);
            super.onDestroy();
        }

        @Override
        public void onSharedPreferenceChanged(SharedPreferences changed, String key) {
            water.setInk(settings.getBoolean(WallpaperSettings.INK, false));
            water.setRain(settings.getBoolean(WallpaperSettings.RAIN, false));
            Uri picture = WallpaperSettings.picture(WaterWallpaper.this);
            if (picture != null) {
                water.setPicture(picture);
            } else {
                water.setPictures(R.drawable.pool_tall, R.drawable.pool, 0);
            }
        }
    }
}
