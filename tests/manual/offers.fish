# What fish offers for each line: offers.fish COMPLETION LINE...
source $argv[1]
for line in $argv[2..]
    # Descriptions come after a tab; what is typed of an option's value is offered with the option.
    echo "$line:" (complete -C $line | string replace -r '\t.*' '' | string replace -r '^--[a-z-]+=' '' | LC_ALL=C sort)
end
