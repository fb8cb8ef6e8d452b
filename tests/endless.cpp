// A program that runs for a day.
#include <chrono>
#include <thread>

int main()
{
    std::this_thread::sleep_for(std::chrono::hours(24));
}
