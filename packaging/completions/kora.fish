# Completes what is typed behind kora.
complete -c kora -f
complete -c kora -s h -l help -d 'Print help and exit'
complete -c kora -l version -d 'Print the version and the revision, and exit'
complete -c kora -l home -x -a '(__fish_complete_directories)' -d 'Folder of the installation'
complete -c kora -l set -x -d 'A setting for this run only'
complete -c kora -a 'RM A N XT XS' -d 'Word of the program'
complete -c kora -k -a '(__fish_complete_suffix .cht)'
