#include "render/row_kernel_variants.h"

#ifdef DRAVENTA_AVX2

#include <immintrin.h>

#include "render/row_loops.h"

namespace {

#define AVX2 __attribute__((target("avx2")))

// Compositing is by hand, in half the instructions that compilers take: they do not see that an
// instruction sums up what lies side by side.

constexpr ptrdiff_t PIXELS = 8;  // in a vector

AVX2 __m256i load(const uint32_t* src) {
    return _mm256_loadu_si256(reinterpret_cast<const __m256i*>(src));
}

// How a vector is stored: through the caches, or past them to memory, which then need not be read
// before it is written.
struct cached {
    AVX2 static void store(uint32_t* dst, __m256i pixels) {
        _mm256_storeu_si256(reinterpret_cast<__m256i*>(dst), pixels);
    }
};

struct streamed {
    AVX2 static void store(uint32_t* dst, __m256i pixels) {
        _mm256_stream_si256(reinterpret_cast<__m256i*>(dst), pixels);
    }
};

AVX2 __m256i grey_of(__m256i pixels) {
    const __m256i not_alpha = _mm256_set1_epi32(0x00010101);
    const __m256i pairs = _mm256_maddubs_epi16(pixels, not_alpha);  // B + G, R
    const __m256i sum = _mm256_madd_epi16(pairs, _mm256_set1_epi16(1));
    const __m256i third = _mm256_mulhi_epu16(sum, _mm256_set1_epi16(0x5556));  // up to 765
    const __m256i into_channels = _mm256_broadcastsi128_si256(
        _mm_setr_epi8(0, 0, 0, -1, 4, 4, 4, -1, 8, 8, 8, -1, 12, 12, 12, -1));
    const __m256i alpha = _mm256_and_si256(pixels, _mm256_set1_epi32(~0xFFFFFF));
    return _mm256_or_si256(alpha, _mm256_shuffle_epi8(third, into_channels));
}

// All bits of the bytes that are 1, of eight.
AVX2 __m128i selected(const uint8_t* mask) {
    const __m128i values = _mm_loadl_epi64(reinterpret_cast<const __m128i*>(mask));
    return _mm_cmpeq_epi8(values, _mm_set1_epi8(1));
}

// What compositing does to the vector at pixel x, and to single pixels.

struct greying {
    const uint32_t* src;
    uint32_t* dst;

    template <class How>
    AVX2 void vector(ptrdiff_t x) const {
        How::store(dst + x, grey_of(load(src + x)));
    }

    void pixels(ptrdiff_t x, ptrdiff_t n) const { scalar::grey(src + x, dst + x, n); }
};

struct colouring {
    const uint32_t* src;
    const uint8_t* mask;
    uint32_t* dst;

    template <class How>
    AVX2 void vector(ptrdiff_t x) const {
        const __m256i pixels = load(src + x), coloured = _mm256_cvtepi8_epi32(selected(mask + x));
        How::store(dst + x, _mm256_blendv_epi8(grey_of(pixels), pixels, coloured));
    }

    void pixels(ptrdiff_t x, ptrdiff_t n) const {
        scalar::colour_selection(src + x, mask + x, dst + x, n);
    }
};

struct inverting {
    const uint32_t* src;
    uint8_t* mask;
    uint32_t* dst;

    template <class How>
    AVX2 void vector(ptrdiff_t x) const {
        const __m128i were_selected = selected(mask + x);
        const __m256i pixels = load(src + x), greyed = _mm256_cvtepi8_epi32(were_selected);
        How::store(dst + x, _mm256_blendv_epi8(pixels, grey_of(pixels), greyed));
        const __m128i inverted = _mm_add_epi8(were_selected, _mm_set1_epi8(1));  // -1 or 0, plus 1
        _mm_storel_epi64(reinterpret_cast<__m128i*>(mask + x), inverted);
    }

    void pixels(ptrdiff_t x, ptrdiff_t n) const {
        scalar::invert_and_colour(src + x, mask + x, dst + x, n);
    }
};

// From this on, results do not fit into the caches of one core, and memory sets the pace. It
// answers faster when several of its pages are worked on in turns.
constexpr ptrdiff_t LARGE = ptrdiff_t{1} << 20;
constexpr ptrdiff_t LINE = 16;    // pixels in what memory reads and writes at once
constexpr ptrdiff_t PAGE = 1024;  // pixels
constexpr ptrdiff_t PAGES = 4;

// How many pixels from dst on lie before the first line that begins there.
ptrdiff_t before_line(const uint32_t* dst) {
    const auto in_line = reinterpret_cast<uintptr_t>(dst) / sizeof *dst % LINE;
    return static_cast<ptrdiff_t>((LINE - in_line) % LINE);
}

// Composes pixels x .. n - 1 as far as PAGES whole ones go; returns the first one left.
template <class Job>
AVX2 ptrdiff_t compose_pages(const Job& job, ptrdiff_t x, ptrdiff_t n) {
    for (; x + PAGES * PAGE <= n; x += PAGES * PAGE) {
        for (ptrdiff_t in_page = x; in_page < x + PAGE; in_page += LINE) {
            for (ptrdiff_t i = in_page; i < in_page + PAGES * PAGE; i += PAGE) {
                job.template vector<streamed>(i);
                job.template vector<streamed>(i + PIXELS);
            }
        }
    }
    _mm_sfence();  // other threads see streamed pixels from here on
    return x;
}

template <class Job>
AVX2 void compose(const Job& job, ptrdiff_t n) {
    ptrdiff_t x = 0;
    if (n >= LARGE) {
        x = before_line(job.dst);
        job.pixels(0, x);
        x = compose_pages(job, x, n);
    }
    for (; x + PIXELS <= n; x += PIXELS) job.template vector<cached>(x);
    job.pixels(x, n - x);
}

AVX2 void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n) { compose(greying{src, dst}, n); }

AVX2 void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    compose(colouring{src, mask, dst}, n);
}

AVX2 void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    compose(inverting{src, mask, dst}, n);
}

AVX2 void invert(uint8_t* mask, ptrdiff_t n) { row_loops::invert(mask, n); }

AVX2 void gather_pixels(const int32_t* from, const int32_t* columns, int32_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

AVX2 void gather_bytes(const uint8_t* from, const int32_t* columns, uint8_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

AVX2 void double_pixels(const int32_t* from, int32_t* to, ptrdiff_t n) {
    row_loops::double_pixels(from, to, n);
}

AVX2 void classify(const uint8_t* mask, uint8_t* classes, ptrdiff_t n) {
    row_loops::classify(mask, classes, n);
}

AVX2 bool outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n) {
    return row_loops::outline(current, around, flags, n);
}

AVX2 bool small_outline(const uint8_t* current, const rows_around& around, uint8_t* flags,
                        ptrdiff_t n) {
    return row_loops::small_outline(current, around, flags, n);
}

AVX2 ptrdiff_t last_selected(const uint8_t* mask, ptrdiff_t n) {
    return row_loops::last_selected(mask, n);
}

// The lowest bits of 32 bytes.
AVX2 uint64_t lowest_bits(__m256i bytes) {
    return static_cast<uint32_t>(_mm256_movemask_epi8(_mm256_slli_epi16(bytes, 7)));
}

AVX2 ptrdiff_t pack_bits(const uint8_t* mask, uint64_t* words, ptrdiff_t count) {
    const __m256i other_bits = _mm256_set1_epi8(~1);
    for (ptrdiff_t word = 0; word < count; ++word) {
        const auto* const values = reinterpret_cast<const __m256i*>(mask + 64 * word);
        const __m256i low = _mm256_loadu_si256(values), high = _mm256_loadu_si256(values + 1);
        if (!_mm256_testz_si256(_mm256_or_si256(low, high), other_bits)) return word;
        words[word] = lowest_bits(high) << 32 | lowest_bits(low);
    }
    return count;
}

}  // namespace

const row_kernels avx2_row_kernels = {"avx2",   grey,          colour_selection, invert_and_colour,
                                      invert,   gather_pixels, gather_bytes,     double_pixels,
                                      classify, outline,       small_outline,    last_selected,
                                      pack_bits};

#endif
