# The tests that need no OpenGL driver; they also run on another processor in an emulator.
set(TIDEMARK_DRIVERLESS_TESTS
    ../bench/ink_grid.cpp
    ../bench/library_forms.cpp
    jni/gesture_test.cpp
    tshader/flush_denormals_test.cpp
    tshader/kernels_test.cpp
    tshader/samplers_test.cpp
    tshader/velocity_packing_test.cpp
    water/mesh_test.cpp
    water/ripples_test.cpp
    water/waves_test.cpp)
