// window_shown PROGRAM [ARGS...]
// Starts the program on the X display of $DISPLAY and prints, in milliseconds, the time
// from just before the fork to the moment the X server maps the program's first top-level
// window, then the window's title; the program is then ended with SIGTERM. Run under an X
// server without a window manager (Xvfb), where top-level windows are children of the root.
#include <X11/Xlib.h>
#include <poll.h>
#include <signal.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <cstdio>
#include <string>

namespace {

double NowMs() {
    timespec ts{};
    clock_gettime(CLOCK_MONOTONIC, &ts);
    return static_cast<double>(ts.tv_sec) * 1e3 + static_cast<double>(ts.tv_nsec) / 1e6;
}

// The window's title as UTF-8 (_NET_WM_NAME), else its WM_NAME.
std::string Title(Display* d, Window w) {
    Atom type = 0;
    int format = 0;
    unsigned long count = 0;
    unsigned long after = 0;
    unsigned char* data = nullptr;
    std::string title;
    if (XGetWindowProperty(d, w, XInternAtom(d, "_NET_WM_NAME", False), 0, 1024, False,
                           XInternAtom(d, "UTF8_STRING", False), &type, &format, &count, &after,
                           &data) == Success &&
        data) {
        title.assign(reinterpret_cast<const char*>(data), count);
        XFree(data);
    }
    char* name = nullptr;
    if (title.empty() && XFetchName(d, w, &name) && name) {
        title = name;
        XFree(name);
    }
    return title;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: window_shown PROGRAM [ARGS...]\n");
        return 2;
    }
    Display* d = XOpenDisplay(nullptr);
    if (!d) {
        std::fprintf(stderr, "window_shown: no X display\n");
        return 2;
    }
    XSelectInput(d, DefaultRootWindow(d), SubstructureNotifyMask);
    XSync(d, False);
    const double start = NowMs();
    const pid_t pid = fork();
    if (pid == 0) {
        execvp(argv[1], argv + 1);
        _exit(127);
    }
    pollfd pfd{ConnectionNumber(d), POLLIN, 0};
    double shownMs = -1;
    Window shown = 0;
    while (shownMs < 0) {
        while (shownMs < 0 && XPending(d) > 0) {
            XEvent e;
            XNextEvent(d, &e);
            if (e.type == MapNotify && e.xmap.event == DefaultRootWindow(d)) {
                shownMs = NowMs() - start;
                shown = e.xmap.window;
            }
        }
        if (shownMs < 0 && waitpid(pid, nullptr, WNOHANG) == pid) {
            std::fprintf(stderr, "window_shown: %s ended without showing a window\n", argv[1]);
            XCloseDisplay(d);
            return 1;
        }
        if (shownMs < 0) {
            poll(&pfd, 1, 100);
        }
    }
    std::printf("%.1f\t%s\n", shownMs, Title(d, shown).c_str());
    kill(pid, SIGTERM);
    waitpid(pid, nullptr, 0);
    XCloseDisplay(d);
    return 0;
}
