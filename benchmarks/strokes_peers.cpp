#include "benchmarks/strokes_peers.h"

#include <opencv2/imgproc.hpp>

// A watershed from the brush's core and rim. Less work: it neither sees the mask nor writes it.
void add_stroke_peers(const std::shared_ptr<stroke>& data, job* j) {
    cv::setNumThreads(1);
    const int side = 2 * data->engine.radius + 1;
    cv::Mat seeds(side, side, CV_32S);
    for (int y = 0; y < side; ++y) {
        for (int x = 0; x < side; ++x) {
            const unsigned char cell = data->engine.brush_map[y * side + x];
            seeds.at<int>(y, x) = cell == BRUSH_INNER ? 0 : cell == BRUSH_CORE ? 1 : 2;
        }
    }
    const auto colours = std::make_shared<cv::Mat>();
    const cv::Mat pixels(PHOTO_HEIGHT, PHOTO_WIDTH, CV_8UC4, photo().data());
    cv::cvtColor(pixels, *colours, cv::COLOR_BGRA2BGR);
    const auto markers = std::make_shared<cv::Mat>();
    j->add_uncompared("cv watershed", [=] {
        for (const dab& d : data->dabs) {
            const ze_rect box = data->square(d);
            seeds.copyTo(*markers);
            cv::watershed(
                (*colours)(cv::Range(box.top, box.bottom + 1), cv::Range(box.left, box.right + 1)),
                *markers);
        }
    });
}
