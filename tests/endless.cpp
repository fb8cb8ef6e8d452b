// A program that does not end by itself on the same day.
#include <chrono>
#include <thread>

int main()
{
    std::this_thread::sleep_for(std::chrono::hours(24));
}
