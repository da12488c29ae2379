// Nothing below the floor.
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Position;

void main()
{
	if (dot(v_Position, u_Up) < 0.0)
		discard;
	gl_FragColor = v_Colour;
}
