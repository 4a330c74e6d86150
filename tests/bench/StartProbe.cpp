// Opens a window as a program of its own does, the one of this program or a bare one of the same size, and tells what
// that took: processor time from the start of the process until the window was painted, in seconds, and the memory that
// is resident a little later, in bytes.

#include "app/PLApplication.h"
#include "platform/Screenshot.h"

#include <QApplication>
#include <QWidget>

#include <cstdio>
#include <cstring>
#include <ctime>
#include <memory>

namespace {

std::unique_ptr<BApplication> openPelorin()
{
    auto application = std::make_unique<PLApplication>(); // opens the window
    handle_pending_messages();
    return application;
}

std::unique_ptr<QWidget> openBareWindow(int& argc, char** argv)
{
    new QApplication(argc, argv); // ends with the process
    auto window = std::make_unique<QWidget>();
    window->setFixedSize(800, 800);
    window->show();
    handle_pending_messages();
    return window;
}

double residentBytes()
{
    double kilobytes = 0;
    FILE* file = std::fopen("/proc/self/status", "r");
    char line[256];
    while (file != nullptr && std::fgets(line, sizeof line, file) != nullptr) {
        if (std::sscanf(line, "VmRSS: %lf", &kilobytes) == 1)
            break;
    }
    if (file != nullptr)
        std::fclose(file);
    return 1024 * kilobytes;
}

} // namespace

int main(int argc, char** argv)
{
    const bool isBare = argc == 2 && std::strcmp(argv[1], "bare") == 0;
    const auto bare = isBare ? openBareWindow(argc, argv) : nullptr;
    const auto pelorin = isBare ? nullptr : openPelorin();
    const double seconds = static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
    for (const std::clock_t end = std::clock() + CLOCKS_PER_SEC / 10; std::clock() < end;)
        handle_pending_messages(); // what is made later, is made by now
    std::printf("%.6f %.0f\n", seconds, residentBytes());
    return 0;
}
