# Builds a plug-in against the installed header, and lays out home/ for `cimhost --home home`:
# run/ (definition), lib/ (plug-in), mof/ (class declarations), logs/.
#
# The Makefile that includes this sets PLUGIN, NAMESPACE and DEFINES.

PKG_CONFIG ?= pkg-config
CFLAGS ?= -O2 -Wall -Wextra

sources = $(wildcard *.c)
library = home/lib/lib$(PLUGIN).so
definition = home/run/$(PLUGIN).xml
declarations = home/mof/$(NAMESPACE)/$(PLUGIN).mof

all: $(library) $(definition) $(declarations) home/logs

$(library): $(sources) $(wildcard *.h)
	mkdir -p $(@D)
	$(CC) -std=c99 -fPIC -fvisibility=hidden $(DEFINES) $$($(PKG_CONFIG) --cflags commonprovider) \
	  $(CPPFLAGS) $(CFLAGS) -shared $(LDFLAGS) -o $@ $(sources)

$(definition): $(PLUGIN).xml
$(declarations): $(PLUGIN).mof
$(definition) $(declarations):
	mkdir -p $(@D)
	cp $< $@

home/logs:
	mkdir -p $@

clean:
	rm -rf home

.PHONY: all clean
