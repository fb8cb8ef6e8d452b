#include <gtest/gtest.h>
#include <wx/init.h>

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    const wxInitializer library;
    return library.IsOk() ? RUN_ALL_TESTS() : 1;
}
