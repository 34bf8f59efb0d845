message(FATAL_ERROR "the module of the host was taken for one of the library")
