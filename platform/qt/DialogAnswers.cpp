#include "platform/DialogAnswers.h"

DialogAnswers& DialogAnswers::current()
{
    static DialogAnswers answers;
    return answers;
}
