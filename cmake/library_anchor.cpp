// The shared object's own translation unit. All code comes from the hsdigcore
// archive, linked whole; the version script decides what is exported.
