package android.os;

import java.util.HashMap;
import java.util.Map;

public final class Bundle implements Parcelable {
    private final Map<String, Object> values = new HashMap<>();

    @Override
    public int describeContents() {
        return 0;
    }

    @Override
    public void writeToParcel(Parcel parcel, int flags) {}

    public void setClassLoader(ClassLoader loader) {}

    public void putParcelable(String key, Parcelable value) {
        values.put(key, value);
    }

    @SuppressWarnings("unchecked")
    public <T extends Parcelable> T getParcelable(String key) {
        return (T) values.get(key);
    }

    public Object get(String key) {
        return values.get(key);
    }

    public void putInt(String key, int value) {
        values.put(key, value);
    }

    public void putBoolean(String key, boolean value) {
        values.put(key, value);
    }

    public boolean getBoolean(String key) {
        return (Boolean) values.getOrDefault(key, false);
    }

    public void putFloat(String key, float value) {
        values.put(key, value);
    }

    public float getFloat(String key) {
        return (Float) values.getOrDefault(key, 0f);
    }
}
