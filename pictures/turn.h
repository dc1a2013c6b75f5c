// A phase that grows by the same angle at every step. The sines of a plane wave at the pixels of a row cost one complex
// multiplication each.
#pragma once

#include <cmath>

namespace tidemark {

class Turn {
public:
    Turn(float start, float step)
        : cosine_(std::cos(start)), sine_(std::sin(start)), stepCosine_(std::cos(step)), stepSine_(std::sin(step)) {}

    float cosine() const { return cosine_; }
    float sine() const { return sine_; }

    void advance() {
        const float cosine = cosine_ * stepCosine_ - sine_ * stepSine_;
        sine_ = cosine_ * stepSine_ + sine_ * stepCosine_;
        cosine_ = cosine;
    }

private:
    float cosine_, sine_;
    float stepCosine_, stepSine_;
};

}  // namespace tidemark
