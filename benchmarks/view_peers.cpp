// The peers scale from one size to another; where a scale times the view's size is not whole,
// theirs is off by a little, and so are some of their pixels. pixman and cairo take the scale
// itself.

#include "benchmarks/view_peers.h"

#include <cairo.h>
#include <libyuv.h>
#include <pixman.h>

#include <algorithm>
#include <opencv2/imgproc.hpp>
#include <vector>

#include "benchmarks/peer_images.h"

namespace {

using std::make_shared;
using std::shared_ptr;

uint32_t* first_pixel(const scene& s) {
    return photo().data() + size_t(s.offset_y) * PHOTO_WIDTH + size_t(s.offset_x);
}

cv::Mat target(const shared_ptr<scene>& s) {
    return {s->rows(), s->columns(), CV_8UC4, s->drawn.data(), size_t(s->view_width) * 4};
}

cv::Mat source(const shared_ptr<scene>& s) {
    return {s->shown_height, s->shown_width, CV_8UC4, first_pixel(*s), size_t{PHOTO_WIDTH} * 4};
}

cv::Mat source_mask(const shared_ptr<scene>& s) {
    unsigned char* const first =
        s->mask.data() + size_t(s->offset_y) * PHOTO_WIDTH + size_t(s->offset_x);
    return {s->shown_height, s->shown_width, CV_8U, first, size_t{PHOTO_WIDTH}};
}

void add_pixman(const shared_ptr<scene>& s, job* j) {
    const auto from = pixman_pixels(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto to = pixman_pixels(s->drawn.data(), s->view_width, s->rows());
    // It samples at the middle of a view pixel, a hair to the left of it.
    const auto step = static_cast<pixman_fixed_t>(s->scale * 65536.0f);
    const pixman_fixed_t middle = (step + 1) / 2 - pixman_fixed_e;
    pixman_transform_t transform = {};
    pixman_transform_init_identity(&transform);
    transform.matrix[0][0] = transform.matrix[1][1] = step;
    transform.matrix[0][2] = pixman_int_to_fixed(s->offset_x) - middle;
    transform.matrix[1][2] = pixman_int_to_fixed(s->offset_y) - middle;
    pixman_image_set_transform(from.get(), &transform);
    pixman_image_set_filter(from.get(), PIXMAN_FILTER_NEAREST, nullptr, 0);
    pixman_image_set_repeat(from.get(), PIXMAN_REPEAT_PAD);
    j->add("pixman", [=] {
        pixman_image_composite32(PIXMAN_OP_SRC, from.get(), nullptr, to.get(), 0, 0, 0, 0, 0, 0,
                                 s->columns(), s->rows());
    });
}

void add_cairo(const shared_ptr<scene>& s, job* j) {
    const auto from = cairo_pixels(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const cairo_picture to = {
        cairo_image_surface_create_for_data(bytes(s->drawn.data()), CAIRO_FORMAT_ARGB32,
                                            s->columns(), s->rows(), s->view_width * 4),
        cairo_surface_destroy};
    const auto context = cairo_on(to);
    cairo_matrix_t matrix;
    cairo_matrix_init(&matrix, double{s->scale}, 0, 0, double{s->scale}, s->offset_x, s->offset_y);
    cairo_set_source_surface(context.get(), from.get(), 0, 0);
    cairo_pattern_t* const pattern = cairo_get_source(context.get());
    cairo_pattern_set_matrix(pattern, &matrix);
    cairo_pattern_set_filter(pattern, CAIRO_FILTER_NEAREST);
    cairo_pattern_set_extend(pattern, CAIRO_EXTEND_PAD);
    cairo_set_operator(context.get(), CAIRO_OPERATOR_SOURCE);
    j->add("cairo", [=] {
        cairo_surface_mark_dirty(to.get());
        cairo_paint(context.get());
        cairo_surface_flush(to.get());
    });
}

// It scales whole pictures, so what is shown has to be cut out first.
void add_leptonica(const shared_ptr<scene>& s, job* j) {
    const auto pix = pix_of(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const shared_ptr<BOX> shown(
        boxCreate(s->offset_x, s->offset_y, s->shown_width, s->shown_height),
        [](BOX* box) { boxDestroy(&box); });
    const auto drawn = make_shared<shared_ptr<PIX>>();
    j->add(
        "leptonica",
        [=] {
            PIX* cut = pixClipRectangle(pix.get(), shown.get(), nullptr);
            drawn->reset();  // before the next one is made: the same memory serves again
            drawn->reset(pixScaleBySampling(cut, 1 / s->scale, 1 / s->scale),
                         [](PIX* p) { pixDestroy(&p); });
            pixDestroy(&cut);
        },
        {},
        [=] {
            const int width = std::min(pixGetWidth(drawn->get()), s->columns());
            const int height = std::min(pixGetHeight(drawn->get()), s->rows());
            const l_uint32* const data = pixGetData(drawn->get());
            for (int y = 0; y < height; ++y) {
                for (int x = 0; x < width; ++x) {
                    const l_uint32 p = data[y * pixGetWidth(drawn->get()) + x];
                    s->drawn[size_t(y) * size_t(s->view_width) + size_t(x)] = p >> 8 | p << 24;
                }
            }
        });
}

}  // namespace

void add_draw_peers(const shared_ptr<scene>& s, job* j) {
    cv::setNumThreads(1);
    const cv::Mat src = source(s), dst = target(s);
    j->add("cv", [=] {
        cv::Mat drawn = dst;
        cv::resize(src, drawn, drawn.size(), 0, 0, cv::INTER_NEAREST);
    });
    j->add("libyuv", [=] {
        libyuv::ARGBScale(bytes(first_pixel(*s)), PHOTO_WIDTH * 4, s->shown_width, s->shown_height,
                          bytes(s->drawn.data()), s->view_width * 4, s->columns(), s->rows(),
                          libyuv::kFilterNone);
    });
    add_pixman(s, j);
    add_cairo(s, j);
    add_leptonica(s, j);
}

// Their outlines have one colour.
void add_outline_peers(const shared_ptr<scene>& s, job* j) {
    cv::setNumThreads(1);
    const cv::Mat src = source(s), dst = target(s), mask = source_mask(s);
    const auto scaled = make_shared<cv::Mat>();
    const auto scale_both = [=] {
        cv::Mat drawn = dst;
        cv::resize(src, drawn, drawn.size(), 0, 0, cv::INTER_NEAREST);
        cv::resize(mask, *scaled, drawn.size(), 0, 0, cv::INTER_NEAREST);
    };
    j->add("cv contours", [=] {
        cv::Mat drawn = dst;
        scale_both();
        std::vector<std::vector<cv::Point>> contours;
        cv::findContours(*scaled, contours, cv::RETR_LIST, cv::CHAIN_APPROX_NONE);
        cv::drawContours(drawn, contours, -1, cv::Scalar::all(255));
    });
    const auto inner = make_shared<cv::Mat>();
    const cv::Mat cross = cv::getStructuringElement(cv::MORPH_CROSS, {3, 3});
    j->add("cv erosion", [=] {
        cv::Mat drawn = dst;
        scale_both();
        cv::erode(*scaled, *inner, cross);
        cv::bitwise_xor(*scaled, *inner, *inner);
        drawn.setTo(cv::Scalar::all(255), *inner);
    });
}
