#include <dlfcn.h>
#include <pthread.h>

#include <atomic>
#include <cerrno>

#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// How many more threads can be started; negative for any number.
std::atomic<int> gLeft{-1};

/// The system refuses to start threads.
class ThreadFaultTest : public TClientFixture {
  protected:
    void TearDown() override
    {
        gLeft = -1;
        TClientFixture::TearDown();
    }
};

TEST_F(ThreadFaultTest, TheThreadsThatThereAreDoTheWork)
{
    const std::vector<std::string> compare = {"compare",   "--detail",        "web01.xml",    "web02.xml.gz",
                                              "web03.xml", "web01-again.xml", "two-boots.xml"};
    const std::string expected = Result(compare);
    const std::string bad = Scratch("bad.xml", "no XML");
    const std::string worse = Scratch("worse.xml", "");
    for (const int left : {0, 1, 2, 3}) {
        gLeft = left;
        EXPECT_EQ(expected, Result(compare)) << left;
        EXPECT_EQ(0, gLeft) << "threads are requested";
        gLeft = left;
        EXPECT_EQ(
            "cimdelta: B:1:1: found no XML, expected CIM-XML, MOF or a recorded answer of HTTP; leave out what is no inventory\n",
            Shorten(Complaint({"compare", "--detail", "web01.xml", bad, worse, "web02.xml"}), bad, "B"));
    }
}

}  // namespace
}  // namespace NORVZEL20

// The linker finds this before the C library's function of the same name.
extern "C" int pthread_create(pthread_t* thread, const pthread_attr_t* attributes, void* (*start)(void*), void* argument) noexcept
{
    using NORVZEL20::gLeft;
    using TFunction = int (*)(pthread_t*, const pthread_attr_t*, void* (*)(void*), void*);
    static const auto function = reinterpret_cast<TFunction>(dlsym(RTLD_NEXT, "pthread_create"));
    if (gLeft == 0) {
        return EAGAIN;
    }
    if (gLeft > 0) {
        --gLeft;
    }
    return function(thread, attributes, start, argument);
}
