#include "app/PLApplication.h"

#include "app/PLWindow.h"

PLApplication::PLApplication() : BApplication("application/x-vnd.Pelorin")
{
    (new PLWindow({50, 50, 850, 850}))->Show();
}

void PLApplication::MessageReceived(BMessage* message)
{
    BApplication::MessageReceived(message);
}
