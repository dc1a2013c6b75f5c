package android.graphics;

public class Matrix {
    public boolean postRotate(float degrees) {
        return true;
    }
}
