// holdfile: keeps a file open the way another Windows program does (Family
// Historian keeps its family file open while it runs), for the tests of
// saving over a file held by someone else. Built only for Windows.
//
//   holdfile PATH share-delete|no-share-delete
//
// Opens PATH for reading and writing, sharing reading and writing with others
// and, with share-delete, deleting and renaming too. Prints "holding" once the
// file is open and keeps it open until its standard input ends; exit status 2
// when the file cannot be opened.
#include <windows.h>

#include <cstdio>
#include <cwchar>

int wmain(int argc, wchar_t** argv)
{
    if (argc != 3 || (std::wcscmp(argv[2], L"share-delete") != 0 && std::wcscmp(argv[2], L"no-share-delete") != 0)) {
        std::fputs("usage: holdfile PATH share-delete|no-share-delete\n", stderr);
        return 2;
    }
    DWORD share = FILE_SHARE_READ | FILE_SHARE_WRITE;
    if (std::wcscmp(argv[2], L"share-delete") == 0)
        share |= FILE_SHARE_DELETE;
    const HANDLE h = CreateFileW(argv[1], GENERIC_READ | GENERIC_WRITE, share, nullptr, OPEN_EXISTING,
                                 FILE_ATTRIBUTE_NORMAL, nullptr);
    if (h == INVALID_HANDLE_VALUE) {
        std::fprintf(stderr, "holdfile: cannot open the file (error %lu)\n", GetLastError());
        return 2;
    }
    std::fputs("holding\n", stdout);
    std::fflush(stdout);
    char buffer[64];
    while (std::fgets(buffer, sizeof buffer, stdin)) {
    }
    CloseHandle(h);
    return 0;
}
