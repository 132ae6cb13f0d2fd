#include "benchmarks/regions_peers.h"

#include <opencv2/imgproc.hpp>
#include <vector>

#include "benchmarks/one_bit.h"

namespace {

using std::make_shared;
using std::shared_ptr;

using contour = std::vector<cv::Point>;

cv::Mat mask_of(const shared_ptr<region_input>& data) {
    return {PHOTO_HEIGHT, PHOTO_WIDTH, CV_8U, data->mask.data()};
}

// A mask of one bit a pixel, made new from `fresh` before each run.
struct one_bit_mask {
    explicit one_bit_mask(const mask_buffer& mask)
        : fresh(one_bit_copy(mask)), pix(one_bit_copy(mask)) {}

    void reset() const { pixCopy(pix.get(), fresh.get()); }

    const shared_ptr<PIX> fresh;
    const shared_ptr<PIX> pix;
};

void keep_largest(PIX* pix) {
    PIXA* parts = nullptr;
    BOXA* boxes = pixConnComp(pix, &parts, 8);
    int best = 0;
    l_int32 best_size = -1;
    for (int i = 0; i < boxaGetCount(boxes); ++i) {
        PIX* part = pixaGetPix(parts, i, L_CLONE);
        l_int32 size = 0;
        pixCountPixels(part, &size, nullptr);
        pixDestroy(&part);
        if (size < best_size) continue;
        best_size = size;
        best = i;
    }
    if (best_size >= 0) {
        l_int32 x = 0, y = 0, width = 0, height = 0;
        boxaGetBoxGeometry(boxes, best, &x, &y, &width, &height);
        PIX* part = pixaGetPix(parts, best, L_CLONE);
        pixClearAll(pix);
        pixRasterop(pix, x, y, width, height, PIX_SRC, part, 0, 0);
        pixDestroy(&part);
    }
    pixaDestroy(&parts);
    boxaDestroy(&boxes);
}

}  // namespace

// None of the peers reports what changed.
void add_fill_peers(const shared_ptr<region_input>& data, job* j) {
    cv::setNumThreads(1);
    const cv::Mat mask = mask_of(data);
    j->add("cv contours", [=] {
        cv::Mat filled = mask;
        std::vector<contour> contours;
        cv::findContours(filled, contours, cv::RETR_EXTERNAL, cv::CHAIN_APPROX_SIMPLE);
        cv::drawContours(filled, contours, -1, cv::Scalar(1), cv::FILLED);
    });
    // What cannot be reached from the left top corner, which is background in these masks.
    const auto reached = make_shared<cv::Mat>();
    j->add("cv flood", [=] {
        cv::Mat filled = mask;
        filled.copyTo(*reached);
        cv::floodFill(*reached, {0, 0}, cv::Scalar(2));
        cv::compare(*reached, 2, filled, cv::CMP_NE);
        cv::bitwise_and(filled, 1, filled);
    });
    const auto bits = make_shared<const one_bit_mask>(data->fresh);
    j->add(
        "leptonica",
        [=] {
            PIX* holes = pixHolesByFilling(bits->pix.get(), 4);
            pixOr(bits->pix.get(), bits->pix.get(), holes);
            pixDestroy(&holes);
        },
        [=] { bits->reset(); }, [=] { copy_to_bytes(bits->pix.get(), &data->mask); });
}

void add_largest_peers(const shared_ptr<region_input>& data, job* j) {
    cv::setNumThreads(1);
    const cv::Mat mask = mask_of(data);
    j->add("cv contours", [=] {
        cv::Mat kept = mask;
        std::vector<contour> contours;
        cv::findContours(kept, contours, cv::RETR_EXTERNAL, cv::CHAIN_APPROX_SIMPLE);
        size_t best = 0;
        double best_area = -1;
        for (size_t i = 0; i < contours.size(); ++i) {
            const double area = cv::contourArea(contours[i]);
            if (area < best_area) continue;
            best_area = area;
            best = i;
        }
        for (size_t i = 0; i < contours.size(); ++i) {
            if (i == best) continue;
            cv::drawContours(kept, contours, static_cast<int>(i), cv::Scalar(0), cv::FILLED);
        }
    });
    const auto labels = make_shared<cv::Mat>();
    j->add("cv components", [=] {
        cv::Mat kept = mask, stats, centroids;
        const int count = cv::connectedComponentsWithStats(kept, *labels, stats, centroids);
        int best = 0;  // the background
        for (int i = 1; i < count; ++i) {
            if (best == 0 ||
                stats.at<int>(i, cv::CC_STAT_AREA) >= stats.at<int>(best, cv::CC_STAT_AREA)) {
                best = i;
            }
        }
        cv::compare(*labels, best, kept, cv::CMP_EQ);
        cv::bitwise_and(kept, 1, kept);
    });
    const auto bits = make_shared<const one_bit_mask>(data->fresh);
    j->add(
        "leptonica", [=] { keep_largest(bits->pix.get()); }, [=] { bits->reset(); },
        [=] { copy_to_bytes(bits->pix.get(), &data->mask); });
}
