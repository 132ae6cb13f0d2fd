/* Selects a dark square in a bright photo with two dabs of the edge-aware brush, and draws the mask
 * as text. Exits 1 when the selection is not the square. */
#include <draventaUtil.h>
#include <stdint.h>
#include <stdio.h>
#include <string.h>

enum { WIDTH = 20, HEIGHT = 12 };

static const char* const expected[HEIGHT] = {
    "....................", "....................", "....................",
    "......########......", "......########......", "......########......",
    "......########......", "......########......", "......########......",
    "....................", "....................", "....................",
};

static int in_square(int x, int y) { return expected[y][x] == '#'; }

int main(void) {
    static int pixels[WIDTH * HEIGHT];
    static unsigned char mask[WIDTH * HEIGHT];
    ze_rect changed, object;
    int x, y, wrong = 0;

    for (y = 0; y < HEIGHT; ++y)
        for (x = 0; x < WIDTH; ++x) {
            const uint32_t colour = in_square(x, y) ? 0xFF303840u : 0xFFE0D8D0u;
            memcpy(&pixels[y * WIDTH + x], &colour, sizeof colour);
        }

    ze_set_brush_size(6, 1);
    if (ze_init_objectsel(WIDTH, HEIGHT) != 1) return 1;
    ze_modify_objectsel(pixels, mask, WIDTH, HEIGHT, 9, 6, 0, 0, 0, &changed, 1);
    ze_modify_objectsel(pixels, mask, WIDTH, HEIGHT, 10, 5, 0, 0, 0, &changed, 1);
    object = ze_get_objectROI();
    ze_destroy_objectsel();

    for (y = 0; y < HEIGHT; ++y) {
        for (x = 0; x < WIDTH; ++x) {
            const int selected = mask[y * WIDTH + x] == 1;
            putchar(selected ? '#' : '.');
            wrong += selected != in_square(x, y);
        }
        putchar('\n');
    }
    printf("object box: columns %d to %d, rows %d to %d\n", object.left, object.right, object.top,
           object.bottom);
    wrong += object.left != 6 || object.right != 13 || object.top != 3 || object.bottom != 8;
    wrong += g_ERBrush != NULL;
    return wrong != 0;
}
