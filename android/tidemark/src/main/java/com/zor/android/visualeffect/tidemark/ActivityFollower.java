package com.zor.android.visualeffect.tidemark;

import android.app.Activity;
import android.app.Application;
import android.os.Bundle;

/** Starts and stops a view with its activity. */
final class ActivityFollower implements Application.ActivityLifecycleCallbacks {
    private final Activity activity;
    private final TidemarkView view;

    ActivityFollower(Activity activity, TidemarkView view) {
        this.activity = activity;
        this.view = view;
    }

    @Override
    public void onActivityStarted(Activity started) {
        if (started == activity) view.onStart();
    }

    @Override
    public void onActivityStopped(Activity stopped) {
        if (stopped == activity) view.onStop();
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
