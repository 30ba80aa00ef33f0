// A key store's library that always answers the same.
extern "C" __attribute__((visibility("default"))) int LBXGetDeviceLockState(const void* options);
int LBXGetDeviceLockState(const void* options) {
    return options ? -1 : ORVO_FAKE_LOCK_STATE;
}
