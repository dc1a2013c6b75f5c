// How finely the water is drawn: cells of at most 6 pixels where the time allows.
#pragma once

class MeshQuality {
public:
    // Chosen by the size of the view, 96 to 256; again at its best for every size.
    void fitTo(int width, int height, float pictureZoom);

    // What the processor spent on a frame, in seconds. Frames that take too long make the mesh coarser.
    void noteWork(double seconds);

    int vertices() const { return vertices_; }

private:
    int vertices_ = 96;
    int frames_ = 0;
    double work_ = 0.0;  // of these frames
};
