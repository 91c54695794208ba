/// Does nothing: what a module of something else would have.
extern "C" void anotherModule();
extern "C" void anotherModule() { }
