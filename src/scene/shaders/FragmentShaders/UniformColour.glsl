// One colour.
uniform vec4 u_colour;

void main()
{
	gl_FragColor = u_colour;
}
