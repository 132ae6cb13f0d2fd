#include "benchmarks/lasso_peers.h"

#include <opencv2/imgproc.hpp>

namespace {

using std::shared_ptr;

// Less work: it is told the corners instead of finding the outline in the mask.
void add_polygon(const shared_ptr<lasso_input>& data, int value, job* j) {
    cv::setNumThreads(1);
    const auto corners = std::make_shared<std::vector<std::vector<cv::Point>>>(1);
    for (size_t i = 0; i < data->corners.size(); i += 2) {
        (*corners)[0].emplace_back(data->corners[i], data->corners[i + 1]);
    }
    const cv::Mat mask(PHOTO_HEIGHT, PHOTO_WIDTH, CV_8U, data->mask.data());
    j->add("cv polygon", [=] {
        cv::Mat filled = mask;
        cv::fillPoly(filled, *corners, cv::Scalar(value));
    });
}

}  // namespace

void add_lasso_adding_peers(const shared_ptr<lasso_input>& data, job* j) {
    add_polygon(data, 1, j);
    const ze_rect& box = data->box;
    const cv::Mat mask(PHOTO_HEIGHT, PHOTO_WIDTH, CV_8U, data->mask.data());
    const cv::Mat inside =
        mask(cv::Range(box.top, box.bottom + 1), cv::Range(box.left, box.right + 1));
    j->add("cv contours", [=] {
        cv::Mat filled = inside;
        std::vector<std::vector<cv::Point>> contours;
        cv::findContours(filled, contours, cv::RETR_EXTERNAL, cv::CHAIN_APPROX_SIMPLE);
        cv::drawContours(filled, contours, -1, cv::Scalar(1), cv::FILLED);
    });
}

void add_lasso_removing_peers(const shared_ptr<lasso_input>& data, job* j) {
    add_polygon(data, 0, j);
}
