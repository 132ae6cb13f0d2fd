// The peers' grey is a weighted sum, not the mean of three channels: the same bytes to read and
// write. Their masks hold 0 and 255, as they like it.

#include "benchmarks/compositing_peers.h"

#include <allheaders.h>
#include <cairo.h>
#include <libyuv.h>
#include <pixman.h>

#include <algorithm>
#include <opencv2/imgproc.hpp>

#include "benchmarks/peer_images.h"

namespace {

using std::make_shared;
using std::shared_ptr;

void yuv_grey(const shared_ptr<composition>& data) {
    const int stride = data->width * 4;
    libyuv::ARGBGrayTo(bytes(photo().data()), stride, bytes(data->drawn.data()), stride,
                       data->width, data->height);
}

cv::Mat source(const shared_ptr<composition>& data) {
    return cv_pixels(photo().data(), data->width, data->height);
}

cv::Mat target(const shared_ptr<composition>& data) {
    return cv_pixels(data->drawn.data(), data->width, data->height);
}

shared_ptr<cv::Mat> cv_mask(const shared_ptr<composition>& data, int width, int height) {
    auto mask = make_shared<cv::Mat>();
    *mask = cv::Mat(height, width, CV_8U, data->mask.data()) * 255;
    return mask;
}

}  // namespace

void add_grey_peers(const shared_ptr<composition>& data, job* j) {
    cv::setNumThreads(1);
    const int width = data->width, height = data->height;
    j->add("libyuv", [=] { yuv_grey(data); });

    // 21 of 64 parts of each colour, and all of alpha.
    j->add("libyuv matrix", [=] {
        static const int8_t thirds[16] = {21, 21, 21, 0, 21, 21, 21, 0, 21, 21, 21, 0, 0, 0, 0, 64};
        libyuv::ARGBColorMatrix(bytes(photo().data()), width * 4, bytes(data->drawn.data()),
                                width * 4, thirds, width, height);
    });

    // The alpha of an opaque photo is 255 here and there.
    const auto grey = make_shared<cv::Mat>();
    const cv::Mat src = source(data), dst = target(data);
    j->add("cv", [=] {
        cv::Mat drawn = dst;
        cv::cvtColor(src, *grey, cv::COLOR_BGRA2GRAY);
        cv::cvtColor(*grey, drawn, cv::COLOR_GRAY2BGRA);
    });

    // Less work: a byte a pixel comes out.
    const shared_ptr<PIX> pix = pix_of(photo().data(), width, height);
    j->add_uncompared("leptonica", [=] {
        PIX* drawn = pixConvertRGBToGray(pix.get(), 0.33f, 0.34f, 0.33f);
        pixDestroy(&drawn);
    });
}

void add_colour_on_grey_peers(const shared_ptr<composition>& data, job* j) {
    cv::setNumThreads(1);
    const auto mask = cv_mask(data, PHOTO_WIDTH, PHOTO_HEIGHT);
    const cv::Mat src = source(data), dst = target(data);
    const auto colour = pixman_pixels(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto drawn = pixman_pixels(data->drawn.data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto alpha = pixman_mask(mask->data, PHOTO_WIDTH, PHOTO_HEIGHT);
    j->add("libyuv + pixman", [=] {
        yuv_grey(data);
        pixman_image_composite32(PIXMAN_OP_OVER, colour.get(), alpha.get(), drawn.get(), 0, 0, 0, 0,
                                 0, 0, PHOTO_WIDTH, PHOTO_HEIGHT);
    });
    j->add("libyuv + cv", [=] {
        yuv_grey(data);
        src.copyTo(dst, *mask);
    });
    const auto surface = cairo_pixels(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto canvas = cairo_pixels(data->drawn.data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto stencil = cairo_mask(mask->data, PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto context = cairo_on(canvas);
    j->add("libyuv + cairo", [=] {
        static_cast<void>(mask);  // the stencil's bytes
        yuv_grey(data);
        cairo_surface_mark_dirty(canvas.get());
        cairo_set_source_surface(context.get(), surface.get(), 0, 0);
        cairo_mask_surface(context.get(), stencil.get(), 0, 0);
        cairo_surface_flush(canvas.get());
    });
}

void add_reverse_peers(const shared_ptr<composition>& data, job* j) {
    cv::setNumThreads(1);
    const auto mask = cv_mask(data, PHOTO_WIDTH, PHOTO_HEIGHT);
    const cv::Mat fresh = mask->clone();
    const cv::Mat src = source(data), dst = target(data);
    const auto reset = [=] { fresh.copyTo(*mask); };
    j->add(
        "libyuv + cv",
        [=] {
            yuv_grey(data);
            cv::bitwise_not(*mask, *mask);
            src.copyTo(dst, *mask);
        },
        reset);
    const auto colour = pixman_pixels(photo().data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto drawn = pixman_pixels(data->drawn.data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto alpha = pixman_mask(mask->data, PHOTO_WIDTH, PHOTO_HEIGHT);
    j->add(
        "libyuv + pixman",
        [=] {
            yuv_grey(data);
            cv::bitwise_not(*mask, *mask);
            pixman_image_composite32(PIXMAN_OP_OVER, colour.get(), alpha.get(), drawn.get(), 0, 0,
                                     0, 0, 0, 0, PHOTO_WIDTH, PHOTO_HEIGHT);
        },
        reset);
}

void add_scaled_reverse_peers(const shared_ptr<composition>& data, int mask_width, int mask_height,
                              job* j) {
    cv::setNumThreads(1);
    const auto mask = cv_mask(data, mask_width, mask_height);
    const cv::Mat fresh = mask->clone();
    const auto large = make_shared<cv::Mat>();
    const cv::Mat src = source(data), dst = target(data);
    j->add(
        "libyuv + cv",
        [=] {
            yuv_grey(data);
            cv::bitwise_not(*mask, *mask);
            cv::resize(*mask, *large, src.size(), 0, 0, cv::INTER_NEAREST);
            src.copyTo(dst, *large);
        },
        [=] { fresh.copyTo(*mask); });
}
