# One interface target carries the project's warning and sanitizer flags, so that
# every target opts in with target_link_libraries and nothing is set directory-wide.
add_library(updater_build_flags INTERFACE)

target_compile_options(updater_build_flags INTERFACE -Wall -Wextra)
if(UPDATER_WERROR)
    target_compile_options(updater_build_flags INTERFACE -Werror)
endif()

if(UPDATER_SANITIZE)
    target_compile_options(updater_build_flags INTERFACE
        -fsanitize=${UPDATER_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
    target_link_options(updater_build_flags INTERFACE -fsanitize=${UPDATER_SANITIZE})
    # GCC's flow analysis misreads the sanitizers' instrumentation of the
    # standard library (std::function inside std::regex) as uninitialised
    # use; the sanitizers themselves check such use at run time.
    target_compile_options(updater_build_flags INTERFACE -Wno-maybe-uninitialized)
endif()
