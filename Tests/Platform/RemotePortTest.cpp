#include "Tests/Platform/ForkedPeer.h"
#include "Tests/Platform/PortFixture.h"
#include "Tests/Platform/RawPeer.h"

#include <csignal>
#include <sys/time.h>

namespace spectrel {
namespace {

using testing::ElementsAre;

class RemotePortTest : public PortFixture {
protected:
    /// An owner of the name in another process: `talk` has the first sender's connection.
    std::unique_ptr<ForkedPeer> owner(const std::function<void(int socket, ForkedPeer& parent)>& talk)
    {
        auto peer = std::make_unique<ForkedPeer>([this, talk](ForkedPeer& parent) {
            const int listening = raw::listenAt(folder.path().string(), Name);
            parent.signal();
            talk(raw::accept(listening), parent);
            return 0;
        });
        peer->await();
        return peer;
    }
    /// An owner that answers as asked, once for each request.
    std::unique_ptr<ForkedPeer> answering(const std::string& answer)
    {
        return owner([answer](int socket, ForkedPeer&) {
            while (!raw::receive(socket).empty() && raw::send(socket, answer)) { }
        });
    }
    std::optional<Bytes> reply;
};

TEST_F(RemotePortTest, NobodyServesTheNameYieldsNoPort)
{
    EXPECT_EQ(ports.createRemote(Name), nullptr);
}

TEST_F(RemotePortTest, StaleFileYieldsNoPort)
{
    owner([](int, ForkedPeer&) {})->kill();
    EXPECT_EQ(ports.createRemote(Name), nullptr);
}

TEST_F(RemotePortTest, BodyOfNoBytesOrOfTooManyIsATransportError)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(send(*remote, 0, ""), SendStatus::TransportError);
    EXPECT_EQ(send(*remote, 0, std::string(LargestMessage + 1, 'x')), SendStatus::TransportError);
    EXPECT_TRUE(remote->isValid());
}

TEST_F(RemotePortTest, RequestReturnsTheReply)
{
    const auto peer = answering(raw::packet(3, 7, 1, "answer"));
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::Success);
    ASSERT_TRUE(reply);
    EXPECT_EQ(text(*reply), "answer");
}

TEST_F(RemotePortTest, RequestAndOneWayMessageAreToldApartOnTheWire)
{
    const auto peer = owner([](int socket, ForkedPeer&) {
        const bool isRight =
            raw::receive(socket) == raw::packet(1, -2, 1, "one") && raw::receive(socket) == raw::packet(2, 7, 2, "two");
        raw::send(socket, raw::packet(3, 7, 2, isRight ? "right" : "wrong"));
    });
    const auto remote = ports.createRemote(Name);
    send(*remote, -2, "one");
    EXPECT_EQ(ask(*remote, "two", reply), SendStatus::Success);
    ASSERT_TRUE(reply);
    EXPECT_EQ(text(*reply), "right");
}

TEST_F(RemotePortTest, LargestReplyArrivesWhole)
{
    const std::string large(LargestMessage, 'r');
    const auto peer = answering(raw::packet(3, 7, 1, large));
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::Success);
    ASSERT_TRUE(reply);
    EXPECT_EQ(text(*reply), large);
}

TEST_F(RemotePortTest, EmptyAnswerIsSuccessWithoutAReply)
{
    const auto peer = answering(raw::packet(3, 7, 1, ""));
    const auto remote = ports.createRemote(Name);
    reply = Bytes {'o', 'l', 'd'};
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::Success);
    EXPECT_FALSE(reply);
}

TEST_F(RemotePortTest, NoAnswerInTimeIsAReceiveTimeout)
{
    const auto peer = owner([](int socket, ForkedPeer& parent) {
        raw::receive(socket);
        parent.await();
    });
    const auto remote = ports.createRemote(Name);
    const auto before = std::chrono::steady_clock::now();
    EXPECT_EQ(ask(*remote, "question", reply, std::chrono::milliseconds(20)), SendStatus::ReceiveTimeout);
    EXPECT_GE(std::chrono::steady_clock::now() - before, std::chrono::milliseconds(20));
    EXPECT_FALSE(reply);
    EXPECT_TRUE(remote->isValid());
}

TEST_F(RemotePortTest, LateReplyOfATimedOutRequestIsDiscarded)
{
    const auto peer = owner([](int socket, ForkedPeer&) {
        raw::receive(socket);
        raw::receive(socket); // the first one has timed out by now
        raw::send(socket, raw::packet(3, 7, 1, "late"));
        raw::send(socket, raw::packet(3, 7, 2, "right"));
        raw::receive(socket);
    });
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "first", reply, std::chrono::milliseconds(1)), SendStatus::ReceiveTimeout);
    EXPECT_EQ(ask(*remote, "second", reply), SendStatus::Success);
    ASSERT_TRUE(reply);
    EXPECT_EQ(text(*reply), "right");
}

TEST_F(RemotePortTest, LateReplyBetweenRequestsIsDiscardedByTheRunLoop)
{
    const auto peer = owner([](int socket, ForkedPeer& parent) {
        raw::receive(socket);
        parent.await();
        raw::send(socket, raw::packet(3, 7, 1, "late"));
        parent.signal();
    });
    const auto remote = ports.createRemote(Name);
    bool isInvalid = false;
    remote->setInvalidationHandler([&] { isInvalid = true; });
    EXPECT_EQ(ask(*remote, "first", reply, std::chrono::milliseconds(1)), SendStatus::ReceiveTimeout);
    peer->signal();
    EXPECT_TRUE(turnUntil([&] { return isInvalid; })); // through the late reply to the peer's end
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(RemotePortTest, FloodOfStrayRepliesDoesNotPassTheTimeout)
{
    const auto peer = owner([](int socket, ForkedPeer&) {
        while (raw::send(socket, raw::packet(3, 7, 999, "stray"))) { }
    });
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "question", reply, std::chrono::milliseconds(20)), SendStatus::ReceiveTimeout);
}

TEST_F(RemotePortTest, PeerThatDiesBetweenRequestAndReplyBecameInvalid)
{
    const auto peer = owner([](int socket, ForkedPeer&) { raw::receive(socket); });
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::BecameInvalid);
    EXPECT_FALSE(reply);
    EXPECT_FALSE(remote->isValid());
    EXPECT_EQ(ask(*remote, "another", reply), SendStatus::Invalid);
}

TEST_F(RemotePortTest, ReplySentBeforeThePeersDeathStillCounts)
{
    const auto peer = owner([](int socket, ForkedPeer& parent) {
        raw::receive(socket);
        raw::send(socket, raw::packet(3, 7, 1, "last words")); // ends with the second message unread
        parent.signal();
    });
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::Success);
    ASSERT_TRUE(reply);
    EXPECT_EQ(text(*reply), "last words");
}

class ReplyGarbageTest : public RemotePortTest, public testing::WithParamInterface<raw::NamedPacket> { };

TEST_P(ReplyGarbageTest, IsATransportErrorAndEndsThePort)
{
    const auto peer = answering(GetParam().bytes);
    const auto remote = ports.createRemote(Name);
    int invalidations = 0;
    remote->setInvalidationHandler([&] { ++invalidations; });
    EXPECT_EQ(ask(*remote, "question", reply), SendStatus::TransportError);
    EXPECT_FALSE(remote->isValid());
    EXPECT_EQ(invalidations, 1);
    EXPECT_EQ(log.takeLog(), "<3>Message port org.spectrel.Test: dropped its owner, which sent what is no reply\n");
}

INSTANTIATE_TEST_SUITE_P(Packets, ReplyGarbageTest,
    testing::Values(raw::NamedPacket {"text", "garbage"},
        raw::NamedPacket {"one-way message", raw::packet(1, 7, 1, "body")},
        raw::NamedPacket {"request", raw::packet(2, 7, 1, "body")},
        raw::NamedPacket {"one byte too many", raw::packet(3, 7, 1, std::string(LargestMessage + 1, 'x'))}));

TEST_F(RemotePortTest, GarbageOutsideOfARequestEndsThePort)
{
    const auto peer = owner([](int socket, ForkedPeer& parent) {
        raw::send(socket, "garbage");
        parent.await();
    });
    const auto remote = ports.createRemote(Name);
    bool isInvalid = false;
    remote->setInvalidationHandler([&] { isInvalid = true; });
    EXPECT_TRUE(turnUntil([&] { return isInvalid; }));
    EXPECT_EQ(log.takeLog(), "<3>Message port org.spectrel.Test: dropped its owner, which sent what is no reply\n");
}

TEST_F(RemotePortTest, PeersDeathIsSeenWithoutATurnOfTheRunLoop)
{
    const auto peer = owner([](int, ForkedPeer& parent) { parent.await(); });
    const auto remote = ports.createRemote(Name);
    EXPECT_TRUE(remote->isValid());
    peer->kill();
    EXPECT_FALSE(remote->isValid());
    EXPECT_EQ(send(*remote, 0, "anybody there?"), SendStatus::Invalid); // and no SIGPIPE
}

TEST_F(RemotePortTest, InvalidationHandlerTellsThePeersDeathOnce)
{
    const auto peer = owner([](int, ForkedPeer& parent) { parent.await(); });
    const auto remote = ports.createRemote(Name);
    int calls = 0;
    remote->setInvalidationHandler([&] { ++calls; });
    peer->kill();
    EXPECT_TRUE(turnUntil([&] { return calls > 0; }));
    remote->invalidate();
    EXPECT_EQ(calls, 1);
}

TEST_F(RemotePortTest, PeerThatClosesBeforeItAcceptedIsNoticed)
{
    const auto local = ports.createLocal(Name, keeping()).port; // never served
    const auto remote = ports.createRemote(Name);
    EXPECT_TRUE(remote->isValid());
    local->invalidate();
    EXPECT_FALSE(remote->isValid());
}

TEST_F(RemotePortTest, InvalidateEndsThePortAndCallsTheHandler)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    int calls = 0;
    remote->setInvalidationHandler([&] { ++calls; });
    remote->invalidate();
    remote->invalidate();
    EXPECT_EQ(calls, 1);
    EXPECT_FALSE(remote->isValid());
    EXPECT_EQ(send(*remote, 0, "x"), SendStatus::Invalid);
}

TEST_F(RemotePortTest, RemovedInvalidationHandlerIsNotCalled)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    int calls = 0;
    remote->setInvalidationHandler([&] { ++calls; });
    remote->setInvalidationHandler({});
    remote->invalidate();
    EXPECT_EQ(calls, 0);
}

TEST_F(RemotePortTest, InvalidationHandlerMayDestroyThePort)
{
    const auto peer = owner([](int, ForkedPeer& parent) { parent.await(); });
    auto remote = ports.createRemote(Name);
    bool isCalled = false;
    remote->setInvalidationHandler([&] {
        remote.reset();
        isCalled = true;
    });
    peer->kill();
    EXPECT_TRUE(turnUntil([&] { return isCalled; }));
    EXPECT_EQ(remote, nullptr);
}

TEST_F(RemotePortTest, FullQueueIsASendTimeout)
{
    const auto local = ports.createLocal(Name, keeping()).port; // never served
    const auto remote = ports.createRemote(Name);
    SendStatus status = SendStatus::Success;
    for (int i = 0; i < 100'000 && status == SendStatus::Success; ++i)
        status = remote->sendRequest(0, bytes("x"), AtOnce, AtOnce, ReplyMode::None, nullptr);
    EXPECT_EQ(status, SendStatus::SendTimeout);
    const auto before = std::chrono::steady_clock::now();
    EXPECT_EQ(remote->sendRequest(0, bytes("x"), std::chrono::milliseconds(20), AtOnce, ReplyMode::None, nullptr),
        SendStatus::SendTimeout);
    EXPECT_GE(std::chrono::steady_clock::now() - before, std::chrono::milliseconds(20));
}

TEST_F(RemotePortTest, SenderThatNeverWaitsGoesOnWhenCalledAndLosesNothing)
{
    constexpr int Count = 20'000;
    int arrived = 0;
    bool isInOrder = true;
    const auto local = serve([&](std::int32_t id, ByteView) {
        isInOrder &= id == arrived++;
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    int next = 0;
    int calls = 0;
    const auto sendOn = [&] {
        while (next < Count
            && remote->sendRequest(next, bytes("message"), AtOnce, AtOnce, ReplyMode::None, nullptr)
                == SendStatus::Success)
            ++next;
    };
    remote->setWritableHandler([&] {
        ++calls;
        sendOn();
    });
    sendOn();
    ASSERT_LT(next, Count);
    EXPECT_EQ(calls, 0);
    ASSERT_TRUE(turnUntil([&] { return arrived == Count; }));
    EXPECT_GT(calls, 0);
    EXPECT_TRUE(isInOrder);
}

TEST_F(RemotePortTest, WritableHandlerSetAfterTheTimeoutIsCalledToo)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    while (remote->sendRequest(0, bytes("x"), AtOnce, AtOnce, ReplyMode::None, nullptr) == SendStatus::Success) { }
    bool isCalled = false;
    remote->setWritableHandler([&] { isCalled = true; });
    EXPECT_TRUE(turnUntil([&] { return isCalled; }));
}

TEST_F(RemotePortTest, WritableHandlerMayDestroyThePort)
{
    const auto local = serve(keeping());
    auto remote = ports.createRemote(Name);
    remote->setWritableHandler([&] { remote.reset(); });
    while (remote->sendRequest(0, bytes("x"), AtOnce, AtOnce, ReplyMode::None, nullptr) == SendStatus::Success) { }
    EXPECT_TRUE(turnUntil([&] { return !remote; }));
}

TEST_F(RemotePortTest, RemovedWritableHandlerIsNotCalled)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    bool isCalled = false;
    remote->setWritableHandler([&] { isCalled = true; });
    std::size_t sent = 0;
    while (remote->sendRequest(0, bytes("x"), AtOnce, AtOnce, ReplyMode::None, nullptr) == SendStatus::Success)
        ++sent;
    remote->setWritableHandler({});
    ASSERT_TRUE(turnUntilReceived(sent));
    send(*remote, 0, "marker");
    ASSERT_TRUE(turnUntilReceived(sent + 1));
    EXPECT_FALSE(isCalled);
}

TEST_F(RemotePortTest, InterruptedWaitGoesOnToItsEnd)
{
    struct sigaction action = {};
    action.sa_handler = [](int) {}; // without SA_RESTART
    struct sigaction former = {};
    ::sigaction(SIGALRM, &action, &former);
    const itimerval often {{0, 1000}, {0, 1000}};
    const itimerval never {};
    const auto peer = owner([](int socket, ForkedPeer& parent) {
        raw::receive(socket);
        parent.await();
    });
    const auto remote = ports.createRemote(Name);
    ::setitimer(ITIMER_REAL, &often, nullptr);
    const auto before = std::chrono::steady_clock::now();
    EXPECT_EQ(ask(*remote, "question", reply, std::chrono::milliseconds(30)), SendStatus::ReceiveTimeout);
    const auto waited = std::chrono::steady_clock::now() - before;
    ::setitimer(ITIMER_REAL, &never, nullptr);
    ::sigaction(SIGALRM, &former, nullptr);
    EXPECT_GE(waited, std::chrono::milliseconds(30));
}

TEST_F(RemotePortTest, OwnPortOfTheProcessCanBeReached)
{
    const auto local = serve(keeping());
    const auto remote = ports.createRemote(Name);
    EXPECT_EQ(remote->name(), Name);
    send(*remote, 3, "to myself");
    ASSERT_TRUE(turnUntilReceived(1));
    EXPECT_THAT(received, ElementsAre("3:to myself"));
}

} // namespace
} // namespace spectrel
