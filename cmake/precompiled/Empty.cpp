// A target that precompiles a header needs a source.
