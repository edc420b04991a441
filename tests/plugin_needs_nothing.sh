#!/usr/bin/env bash
# The plug-in's code calls nothing that opens files, connections, processes or threads, or that reads
# the machine's clock or environment: none of it is among the symbols that it needs.
set -euo pipefail
calls='(f?open(at)?(64)?|creat|read|write|unlink|rename|mkdir|socket|connect|bind|send(to|msg)?|recv'
calls+='|getaddrinfo|fork|vfork|exec[a-z]*|posix_spawnp?|system|popen|pthread_create|getenv|setenv'
calls+='|time|gettimeofday|clock_gettime|localtime(_r)?|dlopen|dlsym|_?exit|abort|signal|sigaction)'
needed=$(nm --dynamic --undefined-only "$1" | awk '{print $2}' | sed 's/@.*//')
[ -n "$needed" ]
if grep -xE "$calls" <<<"$needed" || grep -E 'fstream|filebuf|6thread|filesystem|chrono' <<<"$needed"
then
  echo "the plug-in needs what stands above" >&2
  exit 1
fi
