// quillmark-cli: Quillmark's work without windows, for scripts and batches.
#include <cstdio>

int main(int, char**)
{
    std::fputs("usage: quillmark-cli stats FILE [--settings S.ini]\n", stderr);
    return 2;
}
