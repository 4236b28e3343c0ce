#ifndef APP_ASSIST_INCLUDE_WSIGNAL_H
#define APP_ASSIST_INCLUDE_WSIGNAL_H

#include <functional>
#include <map>
#include <memory>
#include <vector>

#include <Evas.h>

#include "WDefine.h"
#include "WSignalIdGenerator.h"

namespace app_assist
{

template <typename Signature> class WSignal;

// A list of listeners called in the order of registration. A listener may name an owner Evas object: when
// that object is deleted the listener goes with it, so a view need not remove what it added.
// Listeners added while an emission runs hear only the next emissions; listeners removed while it runs are
// skipped from then on and erased when it ends. Main loop only.
template <typename R, typename... Args> class WSignal<R(Args...)>
{
public:
	using Listener = std::function<R(Args...)>;

	WSignal() : __alive(std::make_shared<bool>(true)) {}
	WSignal(const WSignal &) = delete;
	WSignal &operator=(const WSignal &) = delete;

	// Removes the delete callbacks from every owner; listeners are dropped without a call.
	virtual ~WSignal()
	{
		*__alive = false;
		for (auto &entry : __listeners)
			__unwatchOwner(entry.second.get());
		for (auto &record : __pending)
			__unwatchOwner(record.get());
	}

	// Adds a listener; ownerEvasObj (may be null) ends it when deleted. Returns the listener's id.
	// An empty function object is accepted and raises std::bad_function_call when emitted to.
	unsigned int addListener(Listener listener, Evas_Object *ownerEvasObj = nullptr)
	{
		std::unique_ptr<__Record> record(new __Record());
		record->func = std::move(listener);
		record->owner = ownerEvasObj;
		record->id = WSignalIdGenerator::generate();
		record->removed = false;
		record->signal = this;
		unsigned int id = record->id;
		__watchOwner(record.get());
		if (__emitDepth > 0)
			__pending.push_back(std::move(record));
		else
			__listeners.emplace(id, std::move(record));
		return id;
	}

	// Removes the listener with that id. During an emission it is only marked and is erased when the
	// emission ends. An unknown or already removed id logs "Already removed listener! =%d".
	void removeListener(unsigned int id)
	{
		__Record *record = __find(id);
		if (!record || record->removed) {
			WERROR("Already removed listener! =%d", id);
			return;
		}
		if (__emitDepth > 0) {
			record->removed = true;
			return;
		}
		__unwatchOwner(record);
		__erase(id);
	}

	// Calls every listener that is not marked as removed, in id order, with the arguments. The signal may be
	// deleted by a listener: the emission then stops there.
	void emit(Args... args)
	{
		__EmitScope scope(this);
		for (auto it = __listeners.begin(); it != __listeners.end(); ++it) {
			if (it->second->removed)
				continue;
			// A copy, so that a listener that deletes the signal does not free the function it runs in.
			Listener func = it->second->func;
			func(args...);
			if (!*scope.alive)
				return;
		}
	}

	// Number of live listeners, those waiting for the next emission included.
	size_t getListenerCount() const
	{
		size_t count = 0;
		for (auto &entry : __listeners)
			count += entry.second->removed ? 0 : 1;
		for (auto &record : __pending)
			count += record->removed ? 0 : 1;
		return count;
	}

private:
	struct __Record {
		Listener func;
		Evas_Object *owner;
		unsigned int id;
		bool removed;
		WSignal *signal;
	};

	__Record *__find(unsigned int id)
	{
		auto it = __listeners.find(id);
		if (it != __listeners.end())
			return it->second.get();
		for (auto &record : __pending)
			if (record->id == id)
				return record.get();
		return nullptr;
	}

	void __erase(unsigned int id)
	{
		if (__listeners.erase(id))
			return;
		for (auto it = __pending.begin(); it != __pending.end(); ++it) {
			if ((*it)->id == id) {
				__pending.erase(it);
				return;
			}
		}
	}

	// After the outermost emission: drop the marked records, then let the pending ones in.
	void __settle()
	{
		for (auto it = __listeners.begin(); it != __listeners.end();) {
			if (it->second->removed) {
				__unwatchOwner(it->second.get());
				it = __listeners.erase(it);
			} else {
				++it;
			}
		}
		std::vector<std::unique_ptr<__Record>> pending;
		pending.swap(__pending);
		for (auto &record : pending) {
			if (record->removed) {
				__unwatchOwner(record.get());
				continue;
			}
			unsigned int id = record->id;
			__listeners.emplace(id, std::move(record));
		}
	}

	// The owner's delete callback is added at once, also for a pending record, so that an owner deleted
	// before the emission ends cannot leave a dangling record behind.
	static void __watchOwner(__Record *record)
	{
		if (record->owner)
			evas_object_event_callback_add(record->owner, EVAS_CALLBACK_DEL, __ownerDelCb, record);
	}

	static void __unwatchOwner(__Record *record)
	{
		if (record->owner)
			evas_object_event_callback_del_full(record->owner, EVAS_CALLBACK_DEL, __ownerDelCb, record);
		record->owner = nullptr;
	}

	static void __ownerDelCb(void *data, Evas *, Evas_Object *, void *)
	{
		__Record *record = static_cast<__Record *>(data);
		record->owner = nullptr; // the object is going: nothing to unregister from it any more
		if (!record->removed)
			record->signal->removeListener(record->id);
	}

	// Marks the emission and settles the lists when the outermost one ends, also when a listener throws.
	struct __EmitScope {
		explicit __EmitScope(WSignal *sig) : signal(sig), alive(sig->__alive) { ++signal->__emitDepth; }
		~__EmitScope()
		{
			if (!*alive)
				return;
			if (--signal->__emitDepth == 0)
				signal->__settle();
		}
		WSignal *signal;
		std::shared_ptr<bool> alive;
	};

	std::map<unsigned int, std::unique_ptr<__Record>> __listeners;
	std::vector<std::unique_ptr<__Record>> __pending;
	int __emitDepth = 0;
	std::shared_ptr<bool> __alive;
};

} // namespace app_assist

#endif
