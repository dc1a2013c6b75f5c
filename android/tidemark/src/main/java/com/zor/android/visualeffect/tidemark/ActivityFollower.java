package com.zor.android.visualeffect.tidemark;

import android.app.Activity;
import android.app.Application;
import android.os.Bundle;

import java.lang.ref.WeakReference;

/** Starts and stops a view with its activity, and does not keep one in memory that the activity has dropped. */
final class ActivityFollower implements Application.ActivityLifecycleCallbacks {
    private final Activity activity;
    private final WeakReference<TidemarkView> view;

    ActivityFollower(Activity activity, TidemarkView view) {
        this.activity = activity;
        this.view = new WeakReference<>(view);
    }

    @Override
    public void onActivityStarted(Activity started) {
        TidemarkView water = view.get();
        if (started == activity && water != null) water.onStart();
    }

    @Override
    public void onActivityStopped(Activity stopped) {
        TidemarkView water = view.get();
        if (stopped == activity && water != null) water.onStop();
    }

    @Override
    public void onActivityDestroyed(Activity destroyed) {
        if (destroyed == activity) activity.getApplication().unregisterActivityLifecycleCallbacks(this);
    }

    @Override
    public void onActivityCreated(Activity created, Bundle savedState) {}

    @Override
    public void onActivityResumed(Activity resumed) {}

    @Override
    public void onActivityPaused(Activity paused) {}

    @Override
    public void onActivitySaveInstanceState(Activity saved, Bundle state) {}
}
