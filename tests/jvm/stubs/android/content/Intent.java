package android.content;

import android.net.Uri;

public class Intent {
    public static final String ACTION_OPEN_DOCUMENT = "android.intent.action.OPEN_DOCUMENT";
    public static final String CATEGORY_OPENABLE = "android.intent.category.OPENABLE";

    public Intent(String action) {}

    public Intent addCategory(String category) {
        return this;
    }

    public Intent setType(String type) {
        return this;
    }

    public Uri getData() {
        return null;
    }
}
