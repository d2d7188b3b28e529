// TargetLock: holds the lock of a view's window for the length of a scope.
#pragma once

class BView;
class BWindow;


// A view without a window, and a window that cannot be locked, are used without the lock.
class TargetLock {
public:
	explicit TargetLock(BView* view);
	~TargetLock();
	TargetLock(const TargetLock&) = delete;
	TargetLock& operator=(const TargetLock&) = delete;

private:
	BWindow* fWindow; // locked by us, or NULL
};
