#include "benchmarks/object_box_peers.h"

#include <opencv2/imgproc.hpp>

#include "benchmarks/one_bit.h"

namespace {

using std::shared_ptr;

cv::Mat mask_of(const shared_ptr<boxed_mask>& data) {
    return {PHOTO_HEIGHT, PHOTO_WIDTH, CV_8U, data->mask.data()};
}

ze_rect inclusive(int x, int y, int width, int height) {
    return {x, x + width - 1, y, y + height - 1};
}

ze_rect cv_box(const cv::Mat& mask) {
    const cv::Rect r = cv::boundingRect(mask);
    return inclusive(r.x, r.y, r.width, r.height);
}

ze_rect one_bit_box(PIX* pix) {
    BOX* box = nullptr;
    pixClipToForeground(pix, nullptr, &box);
    l_int32 x = 0, y = 0, width = 0, height = 0;
    boxGetGeometry(box, &x, &y, &width, &height);
    boxDestroy(&box);
    return inclusive(x, y, width, height);
}

}  // namespace

void add_box_peers(const shared_ptr<boxed_mask>& data, job* j) {
    cv::setNumThreads(1);
    const cv::Mat mask = mask_of(data);
    j->add("cv", [=] { data->box[0] = cv_box(mask); });
    const shared_ptr<PIX> bits = one_bit_copy(data->fresh);
    j->add("leptonica", [=] { data->box[0] = one_bit_box(bits.get()); });
}

void add_inversion_peers(const shared_ptr<boxed_mask>& data, job* j) {
    cv::setNumThreads(1);
    const cv::Mat mask = mask_of(data);
    j->add("cv", [=] {
        cv::Mat inverted = mask;
        cv::bitwise_xor(inverted, 1, inverted);
        data->box[0] = cv_box(inverted);
    });
    const shared_ptr<PIX> fresh = one_bit_copy(data->fresh), bits = one_bit_copy(data->fresh);
    j->add(
        "leptonica",
        [=] {
            pixInvert(bits.get(), bits.get());
            data->box[0] = one_bit_box(bits.get());
        },
        [=] { pixCopy(bits.get(), fresh.get()); }, [=] { copy_to_bytes(bits.get(), &data->mask); });
}
