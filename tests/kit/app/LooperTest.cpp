#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <thread>
#include <vector>

#include <Looper.h>
#include <Message.h>
#include <Messenger.h>

#include "MainLoop.h"
#include "Recorder.h"

namespace {

constexpr bigtime_t kHangGuard = 30000000;

// Logs its own messages (after running onMessage) and reports its deletion.
class TestLooper : public BLooper {
public:
	explicit TestLooper(MessageLog& log, std::promise<void>* deleted = nullptr)
		: BLooper("test looper"), fLog(log), fDeleted(deleted) {}
	~TestLooper() override
	{
		if (fDeleted != nullptr)
			fDeleted->set_value();
	}

	void MessageReceived(BMessage* message) override
	{
		if (onMessage)
			onMessage(message);
		fLog.Add(*message);
	}

	std::function<void(BMessage*)> onMessage;

private:
	MessageLog& fLog;
	std::promise<void>* fDeleted;
};

void QuitLooper(BLooper* looper)
{
	ASSERT_TRUE(looper->Lock());
	looper->Quit();
}

}

TEST(Looper, ManyThreadsPostingLoseNothingAndKeepEachSendersOrder)
{
	constexpr int kThreads = 8;
	constexpr int kEach = 400;
	MessageLog own;
	auto* looper = new TestLooper(own);
	Recorder* recorder = new Recorder;
	looper->AddHandler(recorder);
	looper->Run();

	std::vector<std::thread> senders;
	for (int sender = 0; sender < kThreads; sender++) {
		senders.emplace_back([=] {
			BMessenger toHandler(recorder);
			for (int i = 0; i < kEach; i++) {
				BMessage message('seq ');
				message.AddInt32("sender", sender);
				message.AddInt32("seq", i);
				// Half go through the looper, half through a messenger.
				status_t status = sender % 2 == 0
					? looper->PostMessage(&message, recorder) : toHandler.SendMessage(&message);
				ASSERT_EQ(B_OK, status);
			}
		});
	}
	for (std::thread& sender : senders)
		sender.join();
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));

	std::vector<int32> next(kThreads, 0);
	for (const BMessage& message : recorder->log.Messages()) {
		const int32 sender = message.GetInt32("sender", -1);
		ASSERT_EQ(next.at(sender), message.GetInt32("seq", -1));
		next[sender]++;
	}
	for (int32 count : next)
		EXPECT_EQ(kEach, count);
	EXPECT_EQ(0u, own.Count());
	QuitLooper(looper);
	delete recorder;
}

TEST(Looper, QuitWhileOthersSendMakesLaterSendsFailCleanly)
{
	MessageLog log;
	std::promise<void> deleted;
	auto* looper = new TestLooper(log, &deleted);
	Recorder recorder;
	looper->AddHandler(&recorder);
	looper->Run();
	const BMessenger toLooper(looper);
	const BMessenger toHandler(&recorder);

	std::atomic<int> accepted{0};
	std::vector<status_t> failures(4, B_OK);
	std::vector<std::thread> senders;
	for (int sender = 0; sender < 4; sender++) {
		senders.emplace_back([&, sender] {
			const BMessenger& target = sender % 2 == 0 ? toLooper : toHandler;
			for (;;) {
				status_t status = target.SendMessage('spam');
				if (status != B_OK) {
					failures[sender] = status;
					return;
				}
				accepted++;
			}
		});
	}
	ASSERT_TRUE(log.WaitForCount(100));
	QuitLooper(looper);
	deleted.get_future().get();
	for (std::thread& sender : senders)
		sender.join();

	for (status_t failure : failures)
		EXPECT_EQ(B_BAD_PORT_ID, failure);
	EXPECT_LE(log.Count() + recorder.log.Count(), static_cast<size_t>(accepted));
	EXPECT_FALSE(toLooper.IsValid());
	EXPECT_EQ(B_BAD_PORT_ID, toHandler.SendMessage('late'));
	EXPECT_EQ(nullptr, recorder.Looper());
	EXPECT_FALSE(recorder.LockLooper());
}

TEST(Looper, OtherThreadsTakeTheLockAndDispatchWaitsForThem)
{
	MessageLog log;
	auto* looper = new TestLooper(log);
	// The creator holds the lock until Run.
	EXPECT_TRUE(looper->IsLocked());
	looper->Run();
	EXPECT_FALSE(looper->IsLocked());

	ASSERT_TRUE(looper->Lock());
	ASSERT_TRUE(looper->Lock());
	EXPECT_EQ(find_thread(NULL), looper->LockingThread());
	EXPECT_EQ(2, looper->CountLocks());
	std::thread([&] {
		EXPECT_FALSE(looper->IsLocked());
		EXPECT_EQ(B_TIMED_OUT, looper->LockWithTimeout(10000));
	}).join();

	ASSERT_EQ(B_OK, looper->PostMessage('wait'));
	// The looper cannot dispatch while this thread holds its lock.
	EXPECT_FALSE(BPrivate::WaitForIdleLoopers(20000));
	EXPECT_EQ(0u, log.Count());
	looper->Unlock();
	EXPECT_EQ(0u, log.Count());
	looper->Unlock();
	ASSERT_TRUE(log.WaitForCount(1));

	Recorder recorder;
	ASSERT_TRUE(looper->Lock());
	looper->AddHandler(&recorder);
	looper->Unlock();
	std::thread([&] {
		ASSERT_TRUE(recorder.LockLooper());
		EXPECT_TRUE(looper->IsLocked());
		ASSERT_EQ(B_OK, looper->PostMessage('lckd', &recorder));
		recorder.UnlockLooper();
	}).join();
	ASSERT_TRUE(recorder.log.WaitForCount(1));
	QuitLooper(looper);
}

// A thread waiting for the lock of a looper that another thread quits (and
// so deletes) is let go with a failure, and the looper's memory is not
// touched after it is gone.
TEST(Looper, WaitersForTheLockOfAQuittingLooperFail)
{
	MessageLog log;
	std::promise<void> deleted;
	auto* looper = new TestLooper(log, &deleted);
	looper->Run();
	ASSERT_TRUE(looper->Lock());
	std::atomic<int> waiting{0};
	std::vector<std::thread> waiters;
	std::atomic<int> failed{0};
	for (int i = 0; i < 4; i++) {
		waiters.emplace_back([&] {
			waiting++;
			if (looper->LockWithTimeout(kHangGuard) != B_OK)
				failed++;
		});
	}
	while (waiting < 4)
		std::this_thread::yield();
	std::this_thread::sleep_for(std::chrono::milliseconds(20));
	looper->Quit();
	for (std::thread& waiter : waiters)
		waiter.join();
	deleted.get_future().wait();
	EXPECT_EQ(4, failed.load());
}

TEST(Looper, DispatchHasTheLockTheThreadAndTheCurrentMessage)
{
	MessageLog log;
	auto* looper = new TestLooper(log);
	bool locked = false, current = false, ownThread = false;
	std::unique_ptr<BMessage> kept;
	looper->onMessage = [&](BMessage* message) {
		locked = looper->IsLocked();
		current = looper->CurrentMessage() == message;
		ownThread = BLooper::LooperForThread(find_thread(NULL)) == looper
			&& looper->Thread() == find_thread(NULL);
		if (message->what == 'keep')
			kept.reset(looper->DetachCurrentMessage());
	};
	looper->Run();
	BMessage message('keep');
	message.AddString("name", "kept");
	ASSERT_EQ(B_OK, looper->PostMessage(&message));
	ASSERT_TRUE(log.WaitForCount(1));
	EXPECT_TRUE(locked);
	EXPECT_TRUE(current);
	EXPECT_TRUE(ownThread);
	// The detached message outlives its dispatch and belongs to us.
	ASSERT_NE(nullptr, kept);
	EXPECT_TRUE(kept->WasDelivered());
	EXPECT_STREQ("kept", kept->GetString("name"));
	EXPECT_EQ(nullptr, BLooper::LooperForThread(find_thread(NULL)));
	// Between dispatches there is no current message.
	ASSERT_TRUE(looper->Lock());
	EXPECT_EQ(nullptr, looper->CurrentMessage());
	looper->Quit();
}

TEST(Looper, MessengersToDeletedTargetsFailInsteadOfCrashing)
{
	MessageLog log;
	auto* looper = new TestLooper(log);
	auto* handler = new Recorder;
	looper->AddHandler(handler);
	looper->Run();
	BMessenger toHandler(handler);
	ASSERT_TRUE(toHandler.IsValid());

	// Sent while the handler lived, delivered after it died: dropped.
	ASSERT_TRUE(looper->Lock());
	ASSERT_EQ(B_OK, toHandler.SendMessage('gone'));
	EXPECT_TRUE(looper->RemoveHandler(handler));
	delete handler;
	looper->Unlock();
	EXPECT_EQ(B_BAD_HANDLER, toHandler.SendMessage('gone'));
	BLooper* targetLooper;
	EXPECT_EQ(nullptr, toHandler.Target(&targetLooper));
	EXPECT_EQ(looper, targetLooper);
	ASSERT_EQ(B_OK, looper->PostMessage('live'));
	ASSERT_TRUE(log.WaitForCount(1));
	EXPECT_EQ(uint32('live'), log.Messages().front().what);

	BMessenger toLooper(looper);
	QuitLooper(looper);
	EXPECT_EQ(B_BAD_PORT_ID, toLooper.SendMessage('gone'));
	EXPECT_FALSE(toLooper.IsValid());
	EXPECT_FALSE(toLooper.LockTarget());
	EXPECT_EQ(nullptr, toLooper.Target(&targetLooper));
	EXPECT_EQ(nullptr, targetLooper);
	EXPECT_EQ(B_BAD_PORT_ID, BMessenger().SendMessage('none'));
}

TEST(Looper, MessengersAndPostsCheckWhereTheHandlerLives)
{
	MessageLog log;
	auto* one = new TestLooper(log);
	auto* other = new TestLooper(log);
	Recorder loose;
	status_t status;
	BMessenger messenger(&loose, NULL, &status);
	EXPECT_EQ(B_BAD_HANDLER, status);
	BMessenger nowhere(static_cast<BHandler*>(NULL), NULL, &status);
	EXPECT_EQ(B_BAD_VALUE, status);
	one->AddHandler(&loose);
	BMessenger mismatched(&loose, other, &status);
	EXPECT_EQ(B_MISMATCHED_VALUES, status);
	EXPECT_EQ(B_MISMATCHED_VALUES, other->PostMessage('nope', &loose));
	// A handler belongs to one looper at a time.
	other->AddHandler(&loose);
	EXPECT_EQ(one, loose.Looper());
	EXPECT_TRUE(one->RemoveHandler(&loose));
	EXPECT_FALSE(one->RemoveHandler(one));
	one->Quit();
	other->Quit();
}

TEST(Looper, HandlerListAndPreferredHandlerChooseTheTarget)
{
	MessageLog log;
	auto* looper = new TestLooper(log);
	Recorder preferred("preferred");
	EXPECT_EQ(1, looper->CountHandlers());
	EXPECT_EQ(looper, looper->HandlerAt(0));
	looper->AddHandler(&preferred);
	EXPECT_EQ(1, looper->IndexOf(&preferred));
	EXPECT_EQ(looper, preferred.NextHandler());
	looper->SetPreferredHandler(&preferred);
	looper->Run();

	// NULL means the preferred handler; the one-argument form the looper.
	ASSERT_EQ(B_OK, looper->PostMessage('pref', NULL));
	ASSERT_EQ(B_OK, looper->PostMessage('self'));
	ASSERT_EQ(B_OK, BMessenger(NULL, looper).SendMessage('pref'));
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	EXPECT_EQ(2u, preferred.log.Count());
	ASSERT_EQ(1u, log.Count());
	EXPECT_EQ(uint32('self'), log.Messages().front().what);

	ASSERT_TRUE(looper->Lock());
	looper->RemoveHandler(&preferred);
	EXPECT_EQ(nullptr, looper->PreferredHandler());
	looper->Unlock();
	ASSERT_EQ(B_OK, looper->PostMessage('pref', NULL));
	ASSERT_TRUE(log.WaitForCount(2));
	QuitLooper(looper);
}

TEST(Looper, QuitRequestedDecidesAndAnswersAWaitingSender)
{
	class Stubborn : public TestLooper {
	public:
		using TestLooper::TestLooper;
		bool QuitRequested() override { return agree; }
		std::atomic<bool> agree{false};
	};
	MessageLog log;
	std::promise<void> deleted;
	auto* looper = new Stubborn(log, &deleted);
	looper->Run();
	BMessenger messenger(looper);

	BMessage reply;
	ASSERT_EQ(B_OK, messenger.SendMessage(B_QUIT_REQUESTED, &reply));
	EXPECT_EQ(uint32(B_REPLY), reply.what);
	EXPECT_FALSE(reply.GetBool("result", true));
	EXPECT_TRUE(messenger.IsValid());

	looper->agree = true;
	ASSERT_EQ(B_OK, messenger.SendMessage(B_QUIT_REQUESTED, &reply));
	EXPECT_TRUE(reply.GetBool("result", false));
	deleted.get_future().get();
	EXPECT_FALSE(messenger.IsValid());
}

TEST(Looper, QuitInItsThreadEndsAfterTheCurrentMessage)
{
	MessageLog log;
	std::promise<void> deleted;
	auto* looper = new TestLooper(log, &deleted);
	bool stillRunning = false;
	looper->onMessage = [&](BMessage* message) {
		if (message->what != 'quit')
			return;
		looper->Quit();
		stillRunning = looper->CurrentMessage() == message;
	};
	looper->Run();
	const BMessenger messenger(looper);
	ASSERT_TRUE(looper->Lock());
	looper->PostMessage('quit');
	looper->PostMessage('late');
	looper->Unlock();
	// The looper is busy until it is deleted.
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	EXPECT_EQ(std::future_status::ready,
		deleted.get_future().wait_for(std::chrono::seconds(0)));

	ASSERT_EQ(1u, log.Count());
	EXPECT_EQ(uint32('quit'), log.Messages().front().what);
	EXPECT_TRUE(stillRunning);
	EXPECT_EQ(B_BAD_PORT_ID, messenger.SendMessage('gone'));
}

TEST(Looper, NeverRunLooperQueuesAndQuitsAtOnce)
{
	MessageLog log;
	std::promise<void> deleted;
	auto* looper = new TestLooper(log, &deleted);
	EXPECT_EQ(B_OK, looper->PostMessage('wait'));
	EXPECT_TRUE(looper->IsMessageWaiting());
	// A looper nobody runs does not keep others from being idle.
	EXPECT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	looper->Quit();
	deleted.get_future().get();
	EXPECT_EQ(0u, log.Count());
}

TEST(Looper, SynchronousSendsGetTheAnswerOrNoReply)
{
	MessageLog log;
	auto* looper = new TestLooper(log);
	status_t toSelf = B_OK;
	looper->onMessage = [&](BMessage* message) {
		if (message->what == 'ping') {
			BMessage pong('pong');
			message->SendReply(&pong);
			EXPECT_EQ(B_DUPLICATE_REPLY, message->SendReply('twic'));
		} else if (message->what == 'self') {
			BMessage reply;
			toSelf = BMessenger(looper).SendMessage('loop', &reply);
		}
	};
	looper->Run();
	BMessenger messenger(looper);

	BMessage reply;
	ASSERT_EQ(B_OK, messenger.SendMessage('ping', &reply));
	EXPECT_EQ(uint32('pong'), reply.what);
	EXPECT_TRUE(reply.IsReply());
	ASSERT_NE(nullptr, reply.Previous());
	EXPECT_EQ(uint32('ping'), reply.Previous()->what);

	ASSERT_EQ(B_OK, messenger.SendMessage('mute', &reply));
	EXPECT_EQ(uint32(B_NO_REPLY), reply.what);
	ASSERT_EQ(B_OK, messenger.SendMessage('self', &reply));
	EXPECT_EQ(B_MESSAGE_TO_SELF, toSelf);
	QuitLooper(looper);
}

TEST(Looper, RepliesGoToTheReplyHandler)
{
	MessageLog log;
	auto* server = new TestLooper(log);
	server->onMessage = [](BMessage* message) {
		if (message->what == 'ping')
			message->SendReply('pong');
	};
	MessageLog clientLog;
	auto* client = new TestLooper(clientLog);
	Recorder replies;
	client->AddHandler(&replies);
	server->Run();
	client->Run();

	ASSERT_EQ(B_OK, BMessenger(server).SendMessage('ping', &replies));
	ASSERT_TRUE(replies.log.WaitForCount(1));
	const BMessage pong = replies.log.Messages().front();
	EXPECT_EQ(uint32('pong'), pong.what);
	EXPECT_TRUE(pong.IsReply());
	// A message never delivered has no one to reply to.
	BMessage unsent('ping');
	EXPECT_EQ(B_BAD_REPLY, unsent.SendReply('pong'));
	QuitLooper(server);
	QuitLooper(client);
}

TEST(Looper, IdleWaitFollowsMessagesFromLooperToLooperAndModalWaits)
{
	MessageLog last;
	auto* second = new TestLooper(last);
	MessageLog firstLog;
	auto* first = new TestLooper(firstLog);
	const BMessenger toSecond(second);
	std::promise<void> release;
	std::promise<void> awake;
	std::shared_future<void> released = release.get_future().share();
	first->onMessage = [&](BMessage* message) {
		if (message->what == 'modl') {
			{
				BPrivate::ModalWaitScope modal;
				released.wait();
			}
			awake.set_value();
			return;
		}
		toSecond.SendMessage(message);
	};
	second->Run();
	first->Run();

	for (int i = 0; i < 50; i++)
		first->PostMessage('step');
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	EXPECT_EQ(50u, last.Count());

	// A looper blocked in a modal call counts as idle, even with messages.
	first->PostMessage('modl');
	first->PostMessage('step');
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	EXPECT_EQ(50u, last.Count());
	// Whoever ends a modal call waits until the caller is out of it.
	release.set_value();
	awake.get_future().get();
	ASSERT_TRUE(BPrivate::WaitForIdleLoopers(kHangGuard));
	EXPECT_EQ(51u, last.Count());
	QuitLooper(first);
	QuitLooper(second);
}
