#include "base/filedescriptor.h"

#include <gtest/gtest.h>

#include <fcntl.h>

#include <utility>

namespace kdx {
namespace {

FileDescriptor something() {
    return FileDescriptor(::open("/dev/null", O_RDONLY | O_CLOEXEC));
}

bool systemKnows(int number) {
    return ::fcntl(number, F_GETFD) >= 0;
}

TEST(FileDescriptorTest, ClosesWhatItHoldsWhenItGoes) {
    int number = -1;
    {
        const FileDescriptor descriptor = something();
        number = descriptor.number();
        EXPECT_TRUE(descriptor.isOpen());
        EXPECT_TRUE(systemKnows(number));
    }
    EXPECT_FALSE(systemKnows(number));
}

TEST(FileDescriptorTest, HandsItOnOpenWhenMoved) {
    FileDescriptor first = something();
    const int number = first.number();
    const FileDescriptor second = std::move(first);
    EXPECT_EQ(second.number(), number);
    EXPECT_TRUE(systemKnows(number));
}

TEST(FileDescriptorTest, ClosesWhatItHeldBeforeItTakesAnother) {
    FileDescriptor descriptor = something();
    FileDescriptor other = something();
    const int before = descriptor.number();
    const int after = other.number();
    descriptor = std::move(other);
    EXPECT_EQ(descriptor.number(), after);
    EXPECT_FALSE(systemKnows(before));
    EXPECT_TRUE(systemKnows(after));
}

TEST(FileDescriptorTest, ClosesOnceAndSaysWhetherThatWentWell) {
    FileDescriptor descriptor = something();
    const int number = descriptor.number();
    EXPECT_TRUE(descriptor.close());
    EXPECT_FALSE(descriptor.isOpen());
    EXPECT_FALSE(systemKnows(number));
    EXPECT_TRUE(descriptor.close()) << "nothing is left to fail";

    FileDescriptor unknown(number);
    EXPECT_FALSE(unknown.close());
}

}  // namespace
}  // namespace kdx
