# What a command of ./dev needs, by the names of Debian's packages. Part of that script, which has `say`
# and `fail`.

# A line a package: what it is for, and how to see that it is there.
package_purpose() {
    case $1 in
        abigail-tools) echo 'compares binary interfaces' ;;
        android-liblog-dev) echo 'the Android log on the desktop' ;;
        binutils) echo 'reads object files' ;;
        clang) echo 'second C++ compiler' ;;
        clang-19) echo 'C++ compiler that counts conditions' ;;
        clang-format) echo 'formatter' ;;
        clang-tidy) echo 'static analysis' ;;
        cmake) echo 'build system' ;;
        doxygen) echo 'makes the reference of the headers' ;;
        g++) echo 'C++ compiler' ;;
        g++-*) echo 'C++ compiler for another processor' ;;
        git) echo 'lists the sources' ;;
        junit5) echo 'Java test framework' ;;
        libbenchmark-dev) echo 'benchmark framework' ;;
        libc++-14-dev | libc++abi-14-dev) echo 'C++ library for MemorySanitizer' ;;
        libcairo2-dev | libleptonica-dev | libopencv-dev | libpixman-1-dev | libyuv-dev)
            echo 'what the benchmarks compare with' ;;
        libclang-rt-*) echo "the clang compilers' sanitizers and counters" ;;
        libgtest-dev | libgmock-dev) echo 'C++ test framework' ;;
        llvm-19) echo 'reads the counts, models ARM cores' ;;
        mold) echo 'quick linker' ;;
        ninja-build) echo 'build tool' ;;
        openjdk-17-jdk-headless) echo 'Java compiler and virtual machine' ;;
        openbox) echo 'manages windows on the display of the tests' ;;
        openjdk-17-jre) echo "Java's windows" ;;
        pkgconf) echo 'finds installed libraries' ;;
        python3) echo 'runs the checks that are scripts' ;;
        python3-matplotlib) echo 'draws the growth plots and reads the photo' ;;
        qemu-user) echo 'runs programs of other processors' ;;
        valgrind) echo 'finds faults in the use of memory' ;;
        xauth) echo 'lets programs onto a display' ;;
        xvfb) echo 'a display without a screen' ;;
    esac
}

runs() { command -v "$1" >/dev/null; }

package_is_there() {
    case $1 in
        g++ | cmake | clang | clang-* | doxygen | git | mold | openbox | valgrind | xauth) runs "$1" ;;
        g++-*) runs "${1#g++-}-g++" ;;
        abigail-tools) runs abidiff ;;
        android-liblog-dev) [ -e /usr/include/android/android/log.h ] ;;
        binutils) runs readelf ;;
        junit5) [ -e /usr/share/java/junit-platform-console-standalone.jar ] ;;
        libbenchmark-dev) [ -e /usr/include/benchmark/benchmark.h ] ;;
        libc++-14-dev) [ -e /usr/lib/llvm-14/include/c++/v1/vector ] ;;
        libc++abi-14-dev) [ -e /usr/lib/llvm-14/lib/libc++abi.so ] ;;
        libcairo2-dev) [ -e /usr/include/cairo/cairo.h ] ;;
        libclang-rt-14-dev) clang_links clang -fsanitize=address,undefined ;;
        libclang-rt-19-dev) clang_links clang-19 -fprofile-instr-generate ;;
        libgmock-dev) [ -e /usr/include/gmock/gmock.h ] ;;
        libgtest-dev) [ -e /usr/include/gtest/gtest.h ] ;;
        libleptonica-dev) [ -e /usr/include/leptonica/allheaders.h ] ;;
        libopencv-dev) compgen -G '/usr/lib/*/cmake/opencv4/OpenCVConfig.cmake' >/dev/null ;;
        libpixman-1-dev) [ -e /usr/include/pixman-1/pixman.h ] ;;
        libyuv-dev) [ -e /usr/include/libyuv.h ] ;;
        llvm-19) runs llvm-cov-19 ;;
        ninja-build) runs ninja ;;
        openjdk-17-jdk-headless) runs javac ;;
        openjdk-17-jre) [ -e "$(java_home)/lib/libawt_xawt.so" ] ;;
        pkgconf) runs pkg-config ;;
        xvfb) runs xvfb-run ;;
        python3) runs python3 ;;
        python3-matplotlib) /usr/bin/python3 -c 'import matplotlib, PIL' 2>/dev/null ;;
        qemu-user) runs qemu-aarch64 ;;
        *) return 1 ;;
    esac
}

clang_links() {
    local compiler=$1
    shift
    echo 'int main(void) { return 0; }' | "$compiler" "$@" -x c - -o /dev/null 2>/dev/null
}

# The folder of the Java in use: that of the javac on the path, as cmake/JavaHome.cmake has it.
java_home() { echo "${JAVA_HOME-$(dirname "$(dirname "$(readlink -f "$(command -v javac)")")")}"; }

# need PACKAGE...: installs those that are missing.
need() {
    local package missing=()
    for package in "$@"; do package_is_there "$package" || missing+=("$package"); done
    [ ${#missing[@]} -eq 0 ] && return
    command -v apt-get >/dev/null ||
        fail "this needs (Debian's names): ${missing[*]}; install them and call again"
    local as_root=()
    if [ "$(id -u)" -ne 0 ]; then
        command -v sudo >/dev/null || fail "run as root: apt-get install ${missing[*]}"
        as_root=(sudo)
    fi
    for package in "${missing[@]}"; do
        say "installing $package ($(package_purpose "$package"))"
    done
    local log
    log=$(mktemp)
    if ! { "${as_root[@]}" apt-get update &&
           DEBIAN_FRONTEND=noninteractive "${as_root[@]}" apt-get install -y \
               --no-install-recommends "${missing[@]}"; } >"$log" 2>&1; then
        tail -n 20 "$log" >&2
        fail "installing ${missing[*]} failed; the whole log is $log"
    fi
    rm -f "$log"
}
