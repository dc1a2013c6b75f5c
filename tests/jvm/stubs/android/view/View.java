package android.view;

public class View {
    public interface OnClickListener {
        void onClick(View view);
    }

    public void setOnClickListener(OnClickListener listener) {}

    public boolean onTouchEvent(MotionEvent event) {
        return false;
    }
}
