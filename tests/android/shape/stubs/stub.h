/* A stub library has the names that a link asks for and nothing behind them. */
#define FUNCTION(name) \
    void name(void) {}
#define OBJECT(name) char name;
