#pragma once

#include <memory>
#include <string>
#include <thread>
#include <vector>

// The update engine of the instrument. A front end registers three callbacks,
// then calls init, update and deinit; every outcome comes back through the
// callbacks only. In main-head mode each phase runs on a worker thread of its
// own and the callbacks fire there; in remote-head mode everything runs on the
// caller's thread.
class UpdateManager
{
public:
    enum Result : int {
        NoUpdates = 0,
        UpdateFinished = 1,
    };

    enum Error : int {
        CheckUpdateFailed = 0,
        UpdateMirrorsFailed = 1,
        UpdateFailed = 2,
        UpdateVexaFailed = 3,
    };

    enum ComponentType : int {
        MainHead = 0,
        VexaModule = 1,
    };

    // One updatable item found by a check. Only `type` steers the installation;
    // the texts travel with the list for the front end.
    struct UpdateComponent
    {
        ComponentType type;
        std::string name;
        std::string installedVersion;
        std::string candidateVersion;
    };

    using ResultCallback = void (*)(Result);
    using ErrorCallback = void (*)(Error);
    using UpdateFoundCallback = void (*)(std::vector<UpdateComponent>);

    static UpdateManager *instance();

    void setCallbacks(ResultCallback resultCallback, ErrorCallback errorCallback,
                      UpdateFoundCallback updateFoundCallback);
    bool validateCallbacks();

    void init(bool isRemoteHead);
    void deinit(bool isRemoteHead);
    void update(std::vector<UpdateComponent> components, bool isRemoteHead);

    // Command runner: the exit code of `command`, everything it printed on
    // standard output in `output`.
    static int runProcess(const std::string &command, std::string &output);

    // Package index and version query.
    static bool updateMirrors();
    static bool checkUpdate(bool skipNoInternetCheck, const std::string &command,
                            std::string &installed, std::string &candidate, bool &checkOk);

    // Main-head workers.
    static void initMainHead();
    static void updateMainHead(std::vector<UpdateComponent> components);
    static void deinitMainHead();
    static bool installUpdate(const std::string &command);

    // Remote-head mode, synchronous on the caller's thread.
    static void initRemoteHead();
    static void updateRemoteHead();
    static void deinitRemoteHead();

    // The instrument's services and the update drive.
    static void stopDRUV();
    static void startDRUV();
    static void stopUpdater();

    // The Vexa module.
    static bool checkVexaUpdate(std::string &installed, std::string &candidate, bool &checkOk);
    static bool uploadVexaFiles();
    static bool installVexaUpdate();
    static bool verifyVexa();

private:
    UpdateManager() = default;

    // Starts `body` as the new worker. The previous worker is detached, not
    // joined: a check or wind-down already under way runs on to its own end.
    template <typename Body, typename... Args>
    void startWorker(Body &&body, Args &&...args);

    std::unique_ptr<std::thread> mThread;
    ResultCallback mResultCallback = nullptr;
    ErrorCallback mErrorCallback = nullptr;
    UpdateFoundCallback mUpdateFoundCallback = nullptr;
};
