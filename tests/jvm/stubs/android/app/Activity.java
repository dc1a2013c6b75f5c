package android.app;

import android.content.ContentResolver;
import android.content.Context;
import android.content.Intent;
import android.os.Bundle;
import android.view.View;

public class Activity extends Context {
    public static final int RESULT_OK = -1;

    protected void onCreate(Bundle savedState) {}

    protected void onResume() {}

    protected void onPause() {}

    protected void onActivityResult(int request, int result, Intent data) {}

    public void setContentView(int layout) {}

    public <T extends View> T findViewById(int id) {
        return null;
    }

    public void startActivityForResult(Intent intent, int request) {}

    public ContentResolver getContentResolver() {
        return null;
    }

    public final void runOnUiThread(Runnable action) {}
}
