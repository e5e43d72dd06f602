#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/Sockets/ListeningInput.h"
#include "Platform/Sockets/OpenStreamInput.h"
#include "Platform/Sockets/PipeInput.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <arpa/inet.h>
#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <string>
#include <string_view>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace spectrel {
namespace {

/// An input on real descriptors; what its listener hears is a story: "came", "bytes:TEXT", "ended" or "ended:REASON".
/// The limit is for failures only.
class StreamInputTest : public testing::Test, public StreamInput::Listener {
protected:
    static constexpr std::chrono::seconds Limit {20};

    void writerCame() override
    {
        story += "came ";
    }
    void bytesCame(ByteView bytes) override
    {
        EXPECT_LE(bytes.size(), StreamInput::LargestRead);
        received.append(bytes.begin(), bytes.end());
        if (dropsAtBytes)
            input->dropWriter();
    }
    void writerEnded(const std::string& reason) override
    {
        story += reason.empty() ? "ended " : "ended:" + reason + " ";
    }

    void open(const std::string& address)
    {
        auto opened = openStreamInput(address);
        ASSERT_TRUE(opened) << opened.failure().text;
        input = *std::move(opened);
        input->start(*this);
    }
    std::string refusal(const std::string& address)
    {
        const auto opened = openStreamInput(address);
        EXPECT_FALSE(opened);
        return opened ? "" : opened.failure().text;
    }
    void makeFifo()
    {
        ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
    }
    /// A writer of the FIFO, which must have a reader.
    FileDescriptor writer() const
    {
        return FileDescriptor(::open(path.c_str(), O_WRONLY | O_NONBLOCK | O_CLOEXEC));
    }
    FileDescriptor unixWriter() const
    {
        sockaddr_un address = {};
        address.sun_family = AF_UNIX;
        std::memcpy(address.sun_path, path.data(), path.size());
        return connected(AF_UNIX, reinterpret_cast<const sockaddr*>(&address), sizeof address);
    }
    /// A writer of the input, which listens at "tcp:127.0.0.1:PORT".
    FileDescriptor tcpWriter() const
    {
        sockaddr_in address = {};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        const std::string& name = input->name();
        address.sin_port = htons(static_cast<std::uint16_t>(std::stoi(name.substr(name.rfind(':') + 1))));
        return connected(AF_INET, reinterpret_cast<const sockaddr*>(&address), sizeof address);
    }
    static FileDescriptor connected(int family, const sockaddr* address, socklen_t length)
    {
        FileDescriptor socket(::socket(family, SOCK_STREAM | SOCK_CLOEXEC, 0));
        EXPECT_EQ(::connect(socket.number(), address, length), 0) << std::strerror(errno);
        return socket;
    }
    static void write(const FileDescriptor& writer, std::string_view text)
    {
        EXPECT_EQ(::write(writer.number(), text.data(), text.size()), static_cast<ssize_t>(text.size()));
    }
    bool turnUntilReceived(std::string_view text)
    {
        return loop.runUntil([this, text] { return received == text; }, Limit);
    }
    bool turnUntilTold(std::string_view told)
    {
        return loop.runUntil([this, told] { return story == told; }, Limit);
    }
    /// Lets everything happen that is due.
    void turn()
    {
        int turns = 0;
        for (int i = 0; i < 10; ++i)
            loop.async([&turns] { ++turns; });
        loop.runUntil([&turns] { return turns == 10; }, Limit);
        bool isOver = false;
        loop.after(std::chrono::milliseconds(1), [&isOver] { isOver = true; });
        loop.runUntil([&isOver] { return isOver; }, Limit);
    }

    ScratchFolder folder;
    std::string path = folder.file("stream");
    QtRunLoop loop;
    std::unique_ptr<StreamInput> input;
    std::string story;
    std::string received;
    bool dropsAtBytes = false;
};

using PipeInputTest = StreamInputTest;

TEST_F(PipeInputTest, WriterOfAFifoComesWithItsFirstBytes)
{
    makeFifo();
    open(path);
    EXPECT_EQ(input->name(), path);
    EXPECT_TRUE(input->takesFurtherWriters());
    const FileDescriptor first = writer();
    turn();
    EXPECT_EQ(story, "");
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    EXPECT_EQ(story, "came ");
}

TEST_F(PipeInputTest, FifoServesOneWriterAfterTheOther)
{
    makeFifo();
    open(path);
    for (const char* told : {"came ended ", "came ended came ended "}) {
        FileDescriptor next = writer();
        ASSERT_TRUE(next);
        write(next, "x");
        next.close();
        EXPECT_TRUE(turnUntilTold(told)) << story;
    }
    EXPECT_EQ(received, "xx");
}

TEST_F(PipeInputTest, WriterOfAFifoThatWritesNothingIsNotTold)
{
    makeFifo();
    open(path);
    writer().close();
    turn();
    EXPECT_EQ(story, "");
    write(writer(), "x");
    EXPECT_TRUE(turnUntilTold("came ended ")) << story;
}

TEST_F(PipeInputTest, PausedInputReadsNothing)
{
    makeFifo();
    open(path);
    input->setPaused(true);
    const FileDescriptor first = writer();
    write(first, "abc");
    turn();
    EXPECT_EQ(received, "");
    input->setPaused(false);
    EXPECT_TRUE(turnUntilReceived("abc"));
}

TEST_F(PipeInputTest, DroppedWriterOfAFifoNoticesAndTheNextIsServed)
{
    makeFifo();
    open(path);
    dropsAtBytes = true;
    const FileDescriptor first = writer();
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    EXPECT_FALSE(writer()) << "a FIFO without a reader can be opened by no writer";
    dropsAtBytes = false;
    FileDescriptor next;
    EXPECT_TRUE(loop.runUntil([&] { return static_cast<bool>(next = writer()); }, Limit));
    write(next, "def");
    EXPECT_TRUE(turnUntilReceived("abcdef"));
    EXPECT_EQ(story, "came came ") << "the end of a dropped writer is not told";
}

TEST_F(PipeInputTest, FifoThatWasRemovedEndsWithItsWriter)
{
    makeFifo();
    open(path);
    FileDescriptor last = writer();
    write(last, "x");
    EXPECT_TRUE(turnUntilReceived("x"));
    ::unlink(path.c_str());
    last.close();
    EXPECT_TRUE(turnUntilTold("came ended:the FIFO cannot be opened again: No such file or directory ")) << story;
    EXPECT_FALSE(input->takesFurtherWriters());
}

TEST_F(PipeInputTest, WhatIsNoStreamIsRefusedWithItsReason)
{
    EXPECT_EQ(refusal(path), path + ": No such file or directory");
    EXPECT_EQ(refusal(folder.path().string()), folder.path().string() + ": Is a directory");
    const std::string file = folder.write("file", "x");
    EXPECT_EQ(refusal(file), file + ": a file, which --replay plays");
    open("unix:" + path);
    EXPECT_EQ(refusal(path), path + ": a socket; to listen on one name it unix:" + path);
}

/// Standard input is another descriptor for as long as a test runs.
class StandardInputTest : public StreamInputTest {
protected:
    void SetUp() override
    {
        int ends[2] = {};
        ASSERT_EQ(::pipe2(ends, O_CLOEXEC), 0);
        ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
        ::close(ends[0]);
        theWriter = FileDescriptor(ends[1]);
    }
    void TearDown() override
    {
        ::dup2(before.number(), STDIN_FILENO);
    }
    FileDescriptor before {::dup(STDIN_FILENO)};
    FileDescriptor theWriter;
};

TEST_F(StandardInputTest, ItsOnlyWriterIsThereFromTheStart)
{
    open("-");
    EXPECT_EQ(input->name(), "standard input");
    EXPECT_FALSE(input->takesFurtherWriters());
    EXPECT_EQ(story, "came ");
    write(theWriter, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    theWriter.close();
    EXPECT_TRUE(turnUntilTold("came ended "));
    turn();
    EXPECT_EQ(story, "came ended ") << "it ends once";
}

using ListeningInputTest = StreamInputTest;

TEST_F(ListeningInputTest, WriterIsToldWhenItComesAndWhenItEnds)
{
    open("unix:" + path);
    EXPECT_EQ(input->name(), "unix:" + path);
    EXPECT_TRUE(input->takesFurtherWriters());
    FileDescriptor first = unixWriter();
    EXPECT_TRUE(turnUntilTold("came "));
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    first.close();
    EXPECT_TRUE(turnUntilTold("came ended "));
}

TEST_F(ListeningInputTest, SecondWriterWaitsForTheEndOfTheFirst)
{
    open("unix:" + path);
    FileDescriptor first = unixWriter();
    FileDescriptor second = unixWriter();
    write(second, "second");
    write(first, "first ");
    EXPECT_TRUE(turnUntilReceived("first "));
    turn();
    EXPECT_EQ(story, "came ");
    first.close();
    EXPECT_TRUE(turnUntilReceived("first second"));
    EXPECT_EQ(story, "came ended came ");
}

TEST_F(ListeningInputTest, PausedInputTakesNoWriter)
{
    open("unix:" + path);
    input->setPaused(true);
    FileDescriptor first = unixWriter();
    write(first, "abc");
    turn();
    EXPECT_EQ(story + received, "");
    input->setPaused(false);
    EXPECT_TRUE(turnUntilReceived("abc"));
    EXPECT_EQ(story, "came ");
}

TEST_F(ListeningInputTest, DroppedWriterIsCutOffAndTheNextIsServed)
{
    open("unix:" + path);
    dropsAtBytes = true;
    FileDescriptor first = unixWriter();
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    char byte = 0;
    EXPECT_EQ(::read(first.number(), &byte, 1), 0);
    dropsAtBytes = false;
    FileDescriptor next = unixWriter();
    write(next, "def");
    EXPECT_TRUE(turnUntilReceived("abcdef"));
    EXPECT_EQ(story, "came came ") << "the end of a dropped writer is not told";
}

TEST_F(ListeningInputTest, SocketIsForThisUserAloneAndGoesWithTheInput)
{
    open("unix:" + path);
    struct stat status { };
    ASSERT_EQ(::lstat(path.c_str(), &status), 0);
    EXPECT_TRUE(S_ISSOCK(status.st_mode));
    EXPECT_EQ(status.st_mode & 0777, 0600u);
    input.reset();
    EXPECT_NE(::lstat(path.c_str(), &status), 0);
}

TEST_F(ListeningInputTest, SocketOfADeadProcessIsTakenOverAndALiveOneIsNot)
{
    {
        sockaddr_un address = {};
        address.sun_family = AF_UNIX;
        std::memcpy(address.sun_path, path.data(), path.size());
        const FileDescriptor dead(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
        ASSERT_EQ(::bind(dead.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    }
    open("unix:" + path);
    EXPECT_EQ(refusal("unix:" + path), "unix:" + path + ": another program listens there");
    write(unixWriter(), "still served");
    EXPECT_TRUE(turnUntilReceived("still served"));
}

TEST_F(ListeningInputTest, WhatStandsAtThePathIsNeverRemoved)
{
    const std::string file = folder.write("file", "precious");
    EXPECT_EQ(refusal("unix:" + file), "unix:" + file + ": something else is there already");
    EXPECT_TRUE(std::filesystem::exists(file));
    EXPECT_EQ(refusal("unix:"), "unix:: a socket's path has 1 to 107 bytes");
    const std::string tooLong = "unix:/" + std::string(107, 'x');
    EXPECT_EQ(refusal(tooLong), tooLong + ": a socket's path has 1 to 107 bytes");
}

TEST_F(ListeningInputTest, PortAloneListensOnThisMachineAndTheSystemsChoiceIsTold)
{
    open("tcp:0");
    EXPECT_TRUE(input->name().starts_with("tcp:127.0.0.1:")) << input->name();
    EXPECT_FALSE(input->name().ends_with(":0")) << input->name();
    FileDescriptor first = tcpWriter();
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
}

TEST_F(ListeningInputTest, ResetConnectionIsTheWritersEndWithItsReason)
{
    open("tcp:127.0.0.1:0");
    FileDescriptor first = tcpWriter();
    write(first, "abc");
    EXPECT_TRUE(turnUntilReceived("abc"));
    const linger atOnce {1, 0};
    ::setsockopt(first.number(), SOL_SOCKET, SO_LINGER, &atOnce, sizeof atOnce);
    first.close();
    EXPECT_TRUE(turnUntilTold("came ended:Connection reset by peer ")) << story;
    write(tcpWriter(), "def");
    EXPECT_TRUE(turnUntilReceived("abcdef"));
}

TEST_F(ListeningInputTest, AddressThatIsNoneIsRefused)
{
    for (const char* address : {"tcp:", "tcp:x", "tcp:65536", "tcp:127.0.0.1:", "tcp:127.0.0.1:-1", "tcp:123456"})
        EXPECT_EQ(
            refusal(address), std::string(address) + ": a port is a number from 0 to 65535, as in tcp:127.0.0.1:4000");
    open("tcp:0");
    EXPECT_EQ(refusal(input->name()), input->name() + ": Address already in use");
}

TEST_F(StreamInputTest, SilentWriterGivesWayToOneThatWaits)
{
    input = *ListeningInput::openTCP("0", std::chrono::milliseconds(20));
    input->start(*this);
    EXPECT_TRUE(input->isOpenToOthers());
    const FileDescriptor silent = tcpWriter();
    ASSERT_TRUE(turnUntilTold("came "));
    const FileDescriptor honest = tcpWriter();
    write(honest, "abc");
    ASSERT_TRUE(turnUntilReceived("abc"));
    EXPECT_EQ(story, "came ended:it sent nothing for 0 s while another one waited came ");
}

TEST_F(StreamInputTest, UnixSocketIsThisUsersAlone)
{
    open("unix:" + path);
    EXPECT_FALSE(input->isOpenToOthers());
}

} // namespace
} // namespace spectrel
