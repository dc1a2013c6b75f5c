package android.widget;

public abstract class CompoundButton extends Button {
    public interface OnCheckedChangeListener {
        void onCheckedChanged(CompoundButton button, boolean checked);
    }

    public void setOnCheckedChangeListener(OnCheckedChangeListener listener) {}
}
