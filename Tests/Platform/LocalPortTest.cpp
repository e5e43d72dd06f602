#include "Platform/Sockets/SocketLocalPort.h"
#include "Platform/Sockets/Wire.h"
#include "Tests/Platform/ForkedPeer.h"
#include "Tests/Platform/PortFixture.h"
#include "Tests/Platform/RawPeer.h"

#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class LocalPortTest : public PortFixture { };

TEST_F(LocalPortTest, MessageArrivesWithItsIdAndBody)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(send(*remote, -5, "hello"), SendStatus::Success);
    ASSERT_TRUE(turnUntilReceived(1));
    EXPECT_THAT(received, ElementsAre("-5:hello"));
}

TEST_F(LocalPortTest, MessagesSentBeforeServingWaitForIt)
{
    const auto local = ports.createLocal(Name, keeping()).port;
    const auto remote = ports.createRemote(Name);
    send(*remote, 0, "early");
    local->serve();
    ASSERT_TRUE(turnUntilReceived(1));
    EXPECT_THAT(received, ElementsAre("0:early"));
}

TEST_F(LocalPortTest, LargestMessageArrivesWhole)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    const std::string large(LargestMessage, 'x');
    EXPECT_EQ(send(*remote, 1, large), SendStatus::Success);
    ASSERT_TRUE(turnUntilReceived(1));
    EXPECT_EQ(received[0], "1:" + large);
}

TEST_F(LocalPortTest, PausedPortLeavesMessagesToWaitAndLosesNone)
{
    std::shared_ptr<LocalMessagePort> local;
    local = serve([&](std::int32_t, ByteView body) {
        received.push_back(text(body));
        local->setPaused(received.size() == 2);
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    for (const char* body : {"1", "2", "3", "4"})
        EXPECT_EQ(send(*remote, 0, body), SendStatus::Success);
    ASSERT_TRUE(turnUntilReceived(2));
    const auto late = ports.createRemote(Name);
    send(*late, 0, "late");
    EXPECT_FALSE(loop.runUntil([this] { return received.size() > 2; }, std::chrono::milliseconds(100)));
    local->setPaused(false);
    ASSERT_TRUE(turnUntilReceived(5));
    EXPECT_THAT(received, ElementsAre("1", "2", "3", "4", "late"));
}

TEST_F(LocalPortTest, SameNameInOneProcessHandsBackTheExistingPort)
{
    const auto first = ports.createLocal(Name, keeping());
    const auto second = ports.createLocal(Name, keeping());
    EXPECT_FALSE(first.existed);
    EXPECT_TRUE(second.existed);
    EXPECT_EQ(second.port, first.port);
}

TEST_F(LocalPortTest, NameHeldByAnotherLiveProcessYieldsNoPort)
{
    ForkedPeer holder([this](ForkedPeer& parent) {
        const auto held = elsewhere.createLocal(Name, keeping());
        parent.signal();
        return parent.await() && held.port ? 0 : 1;
    });
    ASSERT_TRUE(holder.await());
    const auto refused = ports.createLocal(Name, keeping());
    EXPECT_EQ(refused.port, nullptr);
    EXPECT_FALSE(refused.existed);
    holder.signal();
    EXPECT_EQ(holder.finish(), 0);
}

TEST_F(LocalPortTest, StaleNameOfAKilledProcessIsTakenOver)
{
    ForkedPeer holder([this](ForkedPeer& parent) {
        const auto held = elsewhere.createLocal(Name, keeping());
        parent.signal();
        return parent.await() && held.port ? 0 : 1;
    });
    ASSERT_TRUE(holder.await());
    holder.kill();
    EXPECT_EQ(::access((folder.path().string() + "/" + Name).c_str(), F_OK), 0) << "nothing stale to take over";
    const auto local = serve(keeping());
    ASSERT_NE(local, nullptr);
    send(*ports.createRemote(Name), 0, "to the heir");
    EXPECT_TRUE(turnUntilReceived(1));
}

TEST_F(LocalPortTest, OfManyProcessesThatStartAtOnceExactlyOneGetsTheName)
{
    for (int round = 0; round < 10; ++round) {
        std::vector<std::unique_ptr<ForkedPeer>> starters;
        for (int i = 0; i < 6; ++i) {
            starters.push_back(std::make_unique<ForkedPeer>([this](ForkedPeer& parent) {
                parent.await(); // the start
                const auto held = elsewhere.createLocal(Name, keeping());
                parent.signal();
                parent.await(); // everybody has tried
                return held.port ? 1 : 0;
            }));
        }
        for (const auto& starter : starters)
            starter->signal();
        for (const auto& starter : starters)
            ASSERT_TRUE(starter->await());
        int winners = 0;
        for (const auto& starter : starters) {
            starter->signal();
            winners += starter->finish();
        }
        EXPECT_EQ(winners, 1);
    }
}

TEST_F(LocalPortTest, InvalidatedNameIsFreeAtOnce)
{
    const auto local = serve(keeping());
    EXPECT_EQ(elsewhere.createLocal(Name, keeping()).port, nullptr);
    local->invalidate();
    EXPECT_FALSE(local->isValid());
    EXPECT_TRUE(std::filesystem::is_empty(folder.path().string()));
    EXPECT_NE(elsewhere.createLocal(Name, keeping()).port, nullptr);
}

TEST_F(LocalPortTest, DestroyedPortFreesItsName)
{
    serve(keeping()).reset();
    EXPECT_EQ(ports.createRemote(Name), nullptr);
    EXPECT_NE(elsewhere.createLocal(Name, keeping()).port, nullptr);
}

TEST_F(LocalPortTest, AfterInvalidationTheSameProcessGetsANewPort)
{
    const auto first = ports.createLocal(Name, keeping()).port;
    first->invalidate();
    const auto second = ports.createLocal(Name, keeping());
    EXPECT_FALSE(second.existed);
    EXPECT_NE(second.port, first);
    EXPECT_NE(second.port, nullptr);
}

TEST_F(LocalPortTest, InvalidationHandlerIsCalledOnce)
{
    int calls = 0;
    const auto local = serve(keeping());
    local->setInvalidationHandler([&] { ++calls; });
    local->invalidate();
    local->invalidate();
    EXPECT_EQ(calls, 1);
}

TEST_F(LocalPortTest, RemovedInvalidationHandlerIsNotCalled)
{
    int calls = 0;
    const auto local = serve(keeping());
    local->setInvalidationHandler([&] { ++calls; });
    local->setInvalidationHandler({});
    local->invalidate();
    EXPECT_EQ(calls, 0);
}

TEST_F(LocalPortTest, InvalidationHandlerMayDestroyThePortAndTakeTheNameAgain)
{
    auto local = serve(keeping());
    std::shared_ptr<LocalMessagePort> again;
    local->setInvalidationHandler([&] {
        local.reset();
        again = serve(keeping());
    });
    local->invalidate();
    ASSERT_NE(again, nullptr);
    EXPECT_TRUE(again->isValid());
}

TEST_F(LocalPortTest, HandlerMayInvalidateThePortAndNothingFollows)
{
    std::shared_ptr<LocalMessagePort> local;
    local = serve([&](std::int32_t, ByteView body) {
        received.push_back(text(body));
        local->invalidate();
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    send(*remote, 0, "first");
    send(*remote, 0, "second");
    ASSERT_TRUE(turnUntil([&] { return !remote->isValid(); }));
    EXPECT_THAT(received, ElementsAre("first"));
}

TEST_F(LocalPortTest, HandlerMayDestroyThePort)
{
    std::shared_ptr<LocalMessagePort> local;
    local = serve([&](std::int32_t, ByteView body) {
        local.reset();
        received.push_back(text(body)); // the body outlives the port
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    send(*remote, 0, "first");
    send(*remote, 0, "second");
    ASSERT_TRUE(turnUntil([&] { return !remote->isValid(); }));
    EXPECT_THAT(received, ElementsAre("first"));
}

TEST_F(LocalPortTest, RequestIsAnsweredWithItsIdAndSequenceNumber)
{
    const auto local = serve([this](std::int32_t, ByteView body) -> std::optional<Bytes> {
        received.push_back(text(body));
        return Bytes {'y', 'e', 's'};
    });
    ForkedPeer asker([this](ForkedPeer&) {
        const int socket = raw::connectTo(folder.path().string(), Name);
        raw::send(socket, raw::packet(2, 7, 41, "question"));
        const bool isRight = raw::receive(socket) == raw::packet(3, 7, 41, "yes");
        raw::send(socket, raw::packet(1, 0, 0, isRight ? "right" : "wrong"));
        return 0;
    });
    ASSERT_TRUE(turnUntilReceived(2));
    EXPECT_THAT(received, ElementsAre("question", "right"));
}

TEST_F(LocalPortTest, RequestWithoutAnAnswerGetsAnEmptyReplyAndOneWayMessagesGetNone)
{
    const auto local = serve(keeping());
    ForkedPeer asker([this](ForkedPeer&) {
        const int socket = raw::connectTo(folder.path().string(), Name);
        raw::send(socket, raw::packet(1, 1, 1, "one-way"));
        raw::send(socket, raw::packet(2, 2, 2, "question"));
        const bool isRight = raw::receive(socket) == raw::packet(3, 2, 2, "");
        raw::send(socket, raw::packet(1, 3, 3, isRight ? "right" : "wrong"));
        return 0;
    });
    ASSERT_TRUE(turnUntilReceived(3));
    EXPECT_THAT(received, ElementsAre("1:one-way", "2:question", "3:right"));
}

TEST_F(LocalPortTest, AnswerThatIsTooLargeIsLoggedAndLeftEmpty)
{
    const auto local = serve([this](std::int32_t, ByteView body) -> std::optional<Bytes> {
        received.push_back(text(body));
        return Bytes(LargestMessage + 1);
    });
    ForkedPeer asker([this](ForkedPeer&) {
        const int socket = raw::connectTo(folder.path().string(), Name);
        raw::send(socket, raw::packet(2, 2, 2, "question"));
        raw::send(socket, raw::packet(1, 3, 3, raw::receive(socket) == raw::packet(3, 2, 2, "") ? "right" : "wrong"));
        return 0;
    });
    ASSERT_TRUE(turnUntilReceived(2));
    EXPECT_EQ(received[1], "right");
    EXPECT_EQ(log.takeLog(), "<3>Message port org.spectrel.Test: an answer of 262145 bytes is too large\n");
}

class GarbageTest : public LocalPortTest, public testing::WithParamInterface<raw::NamedPacket> { };

TEST_P(GarbageTest, EndsTheConnectionThatSentItAndHarmsNobodyElse)
{
    const auto local = serve(keeping());
    const auto honest = ports.createRemote(Name);
    const int stranger = raw::connectTo(folder.path().string(), Name);
    ASSERT_TRUE(raw::send(stranger, GetParam().bytes));
    raw::send(stranger, raw::packet(1, 9, 9, "after the garbage"));
    send(*honest, 0, "before");
    ASSERT_TRUE(turnUntilReceived(1));
    char byte = 0;
    ASSERT_TRUE(turnUntil([&] { return ::recv(stranger, &byte, 1, MSG_DONTWAIT | MSG_PEEK) >= 0 || errno != EAGAIN; }));
    send(*honest, 0, "after");
    ASSERT_TRUE(turnUntilReceived(2));
    EXPECT_THAT(received, ElementsAre("0:before", "0:after"));
    EXPECT_TRUE(honest->isValid());
    EXPECT_EQ(log.takeLog(), "<3>Message port org.spectrel.Test: dropped a sender that sent what is no message\n");
    ::close(stranger);
}

INSTANTIATE_TEST_SUITE_P(Packets, GarbageTest,
    testing::Values(raw::NamedPacket {"one byte", "x"},
        raw::NamedPacket {"half a header", std::string("\x53\x01\0\0\0\0\0\0\0\0\0", 11)},
        raw::NamedPacket {"message without a body", raw::packet(1, 0, 0, "")},
        raw::NamedPacket {"request without a body", raw::packet(2, 0, 0, "")},
        raw::NamedPacket {"reply to nothing", raw::packet(3, 0, 0, "body")},
        raw::NamedPacket {"kind 0", raw::packet(0, 0, 0, "body")},
        raw::NamedPacket {"kind 4", raw::packet(4, 0, 0, "body")},
        raw::NamedPacket {"another mark", "T" + raw::packet(1, 0, 0, "body").substr(1)},
        raw::NamedPacket {"one byte too many", raw::packet(1, 0, 0, std::string(LargestMessage + 1, 'x'))}));

TEST_F(LocalPortTest, EmptyPacketEndsItsConnectionOnly)
{
    const auto local = serve(keeping());
    const auto honest = ports.createRemote(Name);
    const int stranger = raw::connectTo(folder.path().string(), Name);
    ASSERT_EQ(::send(stranger, "", 0, MSG_NOSIGNAL), 0);
    raw::send(stranger, raw::packet(1, 9, 9, "after"));
    send(*honest, 0, "still here");
    ASSERT_TRUE(turnUntilReceived(1));
    char byte = 0;
    ASSERT_TRUE(turnUntil([&] { return ::recv(stranger, &byte, 1, MSG_DONTWAIT | MSG_PEEK) >= 0 || errno != EAGAIN; }));
    EXPECT_THAT(received, ElementsAre("0:still here"));
    ::close(stranger);
}

TEST_F(LocalPortTest, SendersBeyondTheBoundAreTurnedAwayUntilOneLeaves)
{
    const auto local = serve(keeping());
    std::vector<int> sockets;
    for (std::size_t i = 0; i < SocketLocalPort::MostConnections; ++i) {
        sockets.push_back(raw::connectTo(folder.path().string(), Name));
        ASSERT_TRUE(raw::send(sockets.back(), raw::packet(1, 0, 0, "in")));
        ASSERT_TRUE(turnUntilReceived(i + 1));
    }
    const auto late = ports.createRemote(Name);
    ASSERT_NE(late, nullptr);
    ASSERT_TRUE(turnUntil([&] { return !late->isValid(); }));
    EXPECT_EQ(log.takeLog(), "<3>Message port org.spectrel.Test: more than 64 senders; further ones are turned away\n");
    for (const int socket : sockets)
        ::close(socket);
    ASSERT_TRUE(turnUntil([&] {
        const auto again = ports.createRemote(Name);
        return again && send(*again, 1, "again") == SendStatus::Success && received.back() == "1:again";
    }));
}

TEST_F(LocalPortTest, SenderOfAnotherUserIsTurnedAway)
{
    int pair[2];
    ASSERT_EQ(::socketpair(AF_UNIX, SOCK_SEQPACKET, 0, pair), 0);
    EXPECT_TRUE(wire::isPeerOfThisUser(pair[0]));
    ::close(pair[0]);
    ::close(pair[1]);
    if (::geteuid() != 0)
        return; // only root can be somebody else for a moment
    const auto local = serve(keeping());
    ::chmod(folder.path().string().c_str(), 0755);
    ::chmod((folder.path().string() + "/" + Name).c_str(), 0777);
    ForkedPeer stranger([this](ForkedPeer&) {
        if (::setuid(65534) != 0)
            return 1;
        const int socket = raw::connectTo(folder.path().string(), Name);
        raw::send(socket, raw::packet(1, 0, 0, "let me in"));
        return raw::receive(socket).empty() ? 0 : 2;
    });
    std::string lines;
    ASSERT_TRUE(turnUntil([&] { return !(lines += log.takeLog()).empty(); }));
    EXPECT_EQ(stranger.finish(), 0);
    EXPECT_EQ(lines, "<3>Message port org.spectrel.Test: a sender of another user was turned away\n");
    EXPECT_TRUE(received.empty());
}

TEST_F(LocalPortTest, FolderOfSomebodyElseIsRefused)
{
    std::string foreign = "/"; // root's, for an ordinary user
    if (::geteuid() == 0) {
        foreign = folder.path().string() + "/foreign";
        ASSERT_EQ(::mkdir(foreign.c_str(), 0700), 0);
        ASSERT_EQ(::chown(foreign.c_str(), 65534, 65534), 0);
    }
    SocketMessagePorts refused(foreign, log);
    EXPECT_EQ(refused.createLocal(Name, keeping()).port, nullptr);
    EXPECT_THAT(log.takeLog(), HasSubstr("<3>Message ports: " + foreign + ": not a folder of this user"));
}

TEST_F(LocalPortTest, FolderIsMadeForThisUserAlone)
{
    const std::string nested = folder.path().string() + "/a/b";
    SocketMessagePorts made(nested, log);
    const auto local = made.createLocal(Name, keeping()).port;
    ASSERT_NE(local, nullptr);
    struct stat status = {};
    ASSERT_EQ(::stat(nested.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0700U);
}

TEST_F(LocalPortTest, BatchesAreBoundedAndQueuedJobsRunBetweenThem)
{
    std::size_t count = 0;
    std::size_t seenByJob = 0;
    const auto local = serve([&](std::int32_t, ByteView) {
        if (++count == 1)
            loop.async([&] { seenByJob = count; });
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    for (int i = 0; i < 300; ++i)
        ASSERT_EQ(send(*remote, 0, "x"), SendStatus::Success);
    ASSERT_TRUE(turnUntil([&] { return count == 300; }));
    EXPECT_EQ(seenByJob, 64U);
}

TEST_F(LocalPortTest, EndlessFloodStarvesNeitherTimersNorOtherSenders)
{
    std::size_t flood = 0;
    bool isHonestHeard = false;
    const auto local = serve([&](std::int32_t id, ByteView) {
        ++(id == 0 ? flood : *std::make_unique<std::size_t>());
        isHonestHeard |= id == 1;
        return std::nullopt;
    });
    ForkedPeer flooder([this](ForkedPeer&) {
        const int socket = raw::connectTo(folder.path().string(), Name);
        const auto message = raw::packet(1, 0, 0, "flood");
        while (raw::send(socket, message)) { }
        return 0;
    });
    ASSERT_TRUE(turnUntil([&] { return flood > 0; }));
    int ticks = 0;
    const auto timer = loop.repeat(std::chrono::milliseconds(1), [&] { ++ticks; });
    const auto honest = ports.createRemote(Name);
    ASSERT_EQ(send(*honest, 1, "heard?"), SendStatus::Success);
    EXPECT_TRUE(turnUntil([&] { return ticks >= 5 && isHonestHeard; }));
}

TEST_F(LocalPortTest, FloodSlowsItsSenderAndNothingIsLost)
{
    constexpr int Count = 20'000;
    int next = 0;
    bool isInOrder = true;
    const auto local = serve([&](std::int32_t id, ByteView) {
        isInOrder &= id == next++;
        return std::nullopt;
    });
    ForkedPeer sender([this](ForkedPeer& parent) {
        const int socket = raw::connectTo(folder.path().string(), Name);
        for (int i = 0; i < Count; ++i) {
            if (i == 10)
                parent.signal();
            if (!raw::send(socket, raw::packet(1, i, 0, std::string(200, 'x'))))
                return 1;
        }
        return 0;
    });
    ASSERT_TRUE(sender.await());
    ASSERT_TRUE(turnUntil([&] { return next == Count; }));
    EXPECT_TRUE(isInOrder);
    EXPECT_EQ(sender.finish(), 0);
}

TEST_F(LocalPortTest, SendersThatComeAndGoLeaveNothingBehind)
{
    const auto local = serve(keeping());
    for (std::size_t i = 0; i < 3 * SocketLocalPort::MostConnections; ++i) {
        ASSERT_EQ(send(*ports.createRemote(Name), 0, "x"), SendStatus::Success);
        ASSERT_TRUE(turnUntilReceived(i + 1));
    }
    EXPECT_EQ(log.takeLog(), "");
}

} // namespace
} // namespace spectrel
