// A program of somebody who has nothing but the installed package.
#include "tarnkiln/kernel/Messages.h"

#include <iostream>

namespace messages = tarnkiln::messages;

int main()
{
    try
    {
        tarn::kiln::reportException(messages::NoSuchType(u"Book"));
    }
    catch (messages::NoSuchType const& failure)
    {
        std::cout << "caught: " << failure.what() << '\n';
        return failure.getArguments().size() == 1 ? 0 : 1;
    }
}
