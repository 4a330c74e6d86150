#include "app/PLApplication.h"

#include <memory>

int main()
{
    const auto application = std::make_unique<PLApplication>();
    application->Run();
    return 0;
}
